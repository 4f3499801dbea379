#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// A comparison for programs: one document with the inventories, a summary, the differences and the coverage.
std::string WriteJsonReport(const TComparisonReport& report);

/// The same by lines: a document for each difference, and one for the coverage at the end.
std::string WriteNdjsonReport(const TComparisonReport& report);

}  // namespace NORVZEL20

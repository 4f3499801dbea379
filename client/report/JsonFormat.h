#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// A comparison for programs: one document with the inventories, a summary, the differences and the coverage. Its shape is drawn in
/// JsonFormat.cpp.
std::string WriteJsonReport(const TComparisonReport& report);

/// The same in lines: one document for each difference, and a last one of the kind "coverage" for everything else.
std::string WriteNdjsonReport(const TComparisonReport& report);

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// The summary of a report without differences, for people. "No differences" without reservation is said only if nothing was left
/// out.
std::string DescribeAgreement(const TComparisonReport& report);

}  // namespace NORVZEL20

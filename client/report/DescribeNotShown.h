#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What an option keeps out of the report, `12 changed values not shown (--only +,-)`; empty if it is nothing.
std::string DescribeNotShown(const TComparisonReport& report);

/// The summary of differences that are shown, with that at its end.
std::string AddNotShown(const std::string& summary, const TComparisonReport& report);

}  // namespace NORVZEL20

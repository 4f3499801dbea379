#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What was compared, what was not, and why, for people: the end of a text report. One statement a line.
std::string WriteTextCoverage(const TComparisonReport& report);

}  // namespace NORVZEL20

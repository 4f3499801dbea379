#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What was compared, what was not, and why, for people: the end of a text report. One statement a line; classes with the same
/// statement stand together under a class above them.
std::string WriteTextCoverage(const TComparisonReport& report);

/// The same with each class on its own.
std::string WriteDetailedCoverage(const TComparisonReport& report);

}  // namespace NORVZEL20

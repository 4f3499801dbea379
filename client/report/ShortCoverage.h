#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What was compared and what not, in at most four lines; WriteTextCoverage says all of it, and these lines name the option for
/// that.
std::string WriteShortCoverage(const TComparisonReport& report);

}  // namespace NORVZEL20

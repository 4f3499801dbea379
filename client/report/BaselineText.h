#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"
#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// What a report says of a baseline, with an empty line in front: how many differences are new or accepted, what was accepted with
/// another value, and what is gone. Empty without a baseline. Lists are shortened unless the report is detailed.
std::string WriteBaselineText(const TComparisonReport& report, const TTextOptions& options);

}  // namespace NORVZEL20

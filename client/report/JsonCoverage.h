#pragma once

#include <nlohmann/json.hpp>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What the comparison covered, as the field `coverage` of a JSON report has it. Errors: std::bad_alloc only.
nlohmann::ordered_json JsonOfCoverage(const TComparisonReport& report);

}  // namespace NORVZEL20

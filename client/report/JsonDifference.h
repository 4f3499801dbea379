#pragma once

#include <nlohmann/json.hpp>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// One difference as an object. Its shape is drawn in JsonDifference.cpp.
nlohmann::ordered_json JsonOfDifference(const TComparisonReport& report, const TDifference& difference);

}  // namespace NORVZEL20

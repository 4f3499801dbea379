#pragma once

#include <cstddef>
#include <nlohmann/json.hpp>
#include <vector>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What a kind of difference is called in JSON and in rows of tables.
const char* JsonOfKind(TDifference::EKind kind);

/// The labels of these inventories as a list.
nlohmann::ordered_json JsonOfLabels(const TComparisonReport& report, const std::vector<std::size_t>& inventories);

/// A value and the inventories that have it. Of those that are among `sharing`, which is ascending, it says how many of their
/// instances with the key have the value.
nlohmann::ordered_json JsonOfGroup(const TComparisonReport& report, const TValueDifference::TGroup& group,
                                   const std::vector<std::size_t>& sharing);

/// One difference as an object. Its shape is drawn in JsonDifference.cpp.
nlohmann::ordered_json JsonOfDifference(const TComparisonReport& report, const TDifference& difference);

}  // namespace NORVZEL20

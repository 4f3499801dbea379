#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <vector>

#include "client/findings/TFindings.h"

namespace NORVZEL20 {

/// Positions of inventories, ascending, by a number that they share; the greatest number is first.
using TInventoriesByCount = std::map<std::size_t, std::vector<std::size_t>, std::greater<>>;

/// The inventories but the reference, by the number of their differences.
TInventoriesByCount InventoriesByCount(const TFindings& findings);

}  // namespace NORVZEL20

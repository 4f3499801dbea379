#pragma once

#include <vector>

#include "client/comparison/TDifference.h"

namespace NORVZEL20 {

/// The same difference for some of its inventories, which are ascending and at least one: as if it had been found in them alone.
TDifference ReduceDifference(TDifference difference, const std::vector<std::size_t>& inventories);

}  // namespace NORVZEL20

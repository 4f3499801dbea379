#pragma once

#include <vector>

#include "client/comparison/TDifference.h"
#include "client/comparison/TPropertyOrder.h"

namespace NORVZEL20 {

/// The same difference for some of its inventories, which are ascending and at least one: as if it had been found in them alone.
/// `order` is that of the reference.
TDifference ReduceDifference(TDifference difference, const std::vector<std::size_t>& inventories, TPropertyOrder& order);

}  // namespace NORVZEL20

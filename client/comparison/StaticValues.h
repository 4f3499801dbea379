#pragma once

#include <vector>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// Whether a static property of the first inventory has another value in one of the others, or is none there.
///
/// Such a value is one for all instances of a class: a run that gives it to the first instance that differs has given it to all.
bool StaticValuesDiffer(const std::vector<TInventory>& inventories);

}  // namespace NORVZEL20

#pragma once

#include <vector>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// Whether a static property of the first inventory has another value in one of the others, or is not static there.
///
/// All instances of a class share the value of a static property. A run that brings the first inventory in line with another one
/// would therefore change all of them with the first instance that differs.
bool StaticValuesDiffer(const std::vector<TInventory>& inventories);

}  // namespace NORVZEL20

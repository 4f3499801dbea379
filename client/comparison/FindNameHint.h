#pragma once

#include <optional>
#include <vector>

#include "client/comparison/TNameHint.h"
#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// A class without a single match, because a key has one value throughout the reference and another one throughout another
/// inventory: probably the name of the system. Of several such classes, the one with most instances in the reference; classes
/// with less than two in an inventory do not count. Call it before the run, with the inventories of the run in its order.
/// Errors: std::bad_alloc. Cost: one pass over the values of keys that have one value; of other keys, two values.
std::optional<TNameHint> FindNameHint(const std::vector<TInventory>& inventories, TRules& rules,
                                      const std::vector<TSchemaNote>& notes);

}  // namespace NORVZEL20

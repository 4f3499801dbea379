#pragma once

#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// What the schemas of the others say otherwise than the reference, the first inventory, about the classes that both declare:
/// types, keys, kinds of arrays, superclasses; `withSpelling` adds the letter case of classes and keys. Use it before the schemas
/// are completed, because a key that is declared late has no values.
///
/// Two inventories of which neither is the reference are never compared, so they are not held against each other. No error.
std::vector<TSchemaNote> FindSchemaDifferences(const std::vector<TInventory>& inventories, bool withSpelling);

}  // namespace NORVZEL20

#pragma once

#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// What the schemas of the others say otherwise than the reference, the first inventory: types, keys, kinds of arrays,
/// superclasses. `completed` is what TSchemaCompletion did to the inventories. What the reference lacked was declared in it as in
/// the first inventory that has it; the others are held against that one. No error.
std::vector<TSchemaNote> FindSchemaDifferences(const std::vector<TInventory>& inventories,
                                               const std::vector<TSchemaNote>& completed);

/// The same of inventories that are not completed, and the letter case of classes and keys. What the reference lacks is not
/// compared, and nothing is said of it. No error.
std::vector<TSchemaNote> FindSchemaDifferencesAndSpelling(const std::vector<TInventory>& inventories);

}  // namespace NORVZEL20

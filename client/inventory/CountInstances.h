#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

// Instances that came from inventories. One that the client made (see TSchemaNote) does not count.

/// Those of the class itself, in all inventories. An inventory that does not declare the class has none.
std::size_t CountOwnInstances(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes,
                              const std::string& className);

/// Those of the class and of the classes that the reference, the first inventory, declares below it. The reference must declare
/// the class; the root class counts as declared. Errors: TZELException of the namespace.
std::size_t CountInstancesOfTree(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes,
                                 const std::string& className);

}  // namespace NORVZEL20

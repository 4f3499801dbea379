#pragma once

#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSystemNames.h"

namespace NORVZEL20 {

/// Checks the options, for which no inventory is needed. Errors: TClientError if names that mean one system are not at least two.
void CheckSystemNames(const TSystemNames& options);

/// Writes the names by which the inventories call their own systems as the reference has them, in keys and references, and notes in
/// TInventory::ownNames what was done. Does nothing without such options, which must have passed CheckSystemNames. Call it
/// before the schemas are completed.
///
/// Of several names that mean one system, an inventory's own is the one that it has most often in keys and references. If they have
/// none of them, it is the name that `self` finds, if that is one of them or one of them is the inventory's label; otherwise the
/// one that is most often the value of a property. The reference's own name is used for all. An inventory whose own name is in no
/// key or reference stays as it is. Errors: TClientError if the reference has no own name, an inventory has two names equally
/// often, a name is found nowhere, or two instances would have the same keys; std::bad_alloc. Other inventories may be changed by
/// then. Cost: some passes over the keys, references and values of each inventory.
void AlignSystemNames(std::vector<TInventory>& inventories, const TSystemNames& options);

}  // namespace NORVZEL20

#pragma once

#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// Makes the inventories comparable with each other: first MakeMissingOperatingSystems, then TSchemaCompletion. Returns the notes
/// of both and those of FindSchemaDifferences: operating systems first, then ordered by the inventory whose declarations were
/// taken, and by class; the order of classes in the files has no influence. Errors: TClientError; the inventories may be changed by
/// then.
std::vector<TSchemaNote> CompleteInventories(std::vector<TInventory>& inventories);

/// The notes about inventories that are to be left as they are, in the same order.
std::vector<TSchemaNote> InspectInventories(const std::vector<TInventory>& inventories);

}  // namespace NORVZEL20

#pragma once

#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Makes the inventories comparable with each other: first MakeMissingOperatingSystems, with a message on the console for each
/// instance made, then TSchemaCompletion. Returns the notes of both. Errors: TClientError; the inventories may be changed by then.
std::vector<TSchemaNote> CompleteInventories(std::vector<TInventory>& inventories, IConsole& console);

}  // namespace NORVZEL20

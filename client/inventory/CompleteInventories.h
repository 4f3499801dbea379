#pragma once

#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Makes the inventories comparable with each other: a KALMO_OperatingSystem where there is none (the console is told), then what
/// TSchemaCompletion does. Returns what was done. Errors: TClientError.
std::vector<TSchemaNote> CompleteInventories(std::vector<TInventory>& inventories, IConsole& console);

}  // namespace NORVZEL20

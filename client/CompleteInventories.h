#pragma once

#include <vector>

#include "client/IConsole.h"
#include "client/TInventory.h"
#include "client/TSchemaNote.h"

namespace NORVZEL20 {

/// Makes the inventories comparable with each other: a KALMO_OperatingSystem where there is none (the console is told), then what
/// TSchemaCompletion does. Returns what was done. Errors: TClientError.
std::vector<TSchemaNote> CompleteInventories(std::vector<TInventory>& inventories, IConsole& console);

}  // namespace NORVZEL20

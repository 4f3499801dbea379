#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"

namespace NORVZEL20 {

/// Opens each file and reads its first bytes, which takes no time, before the first of them is loaded, which may take long. Nothing
/// is read of standard input, pipes and devices, because it could not be read again. Errors: TClientError, that of TInventoryFile
/// for the first file that cannot be read. The message ends with the names of the others.
void CheckInventoryFiles(const std::vector<std::string>& paths);

/// Checks that standard input and each pipe are to be read only once by the inventories, their schema and the rules. An empty
/// path of rules means none. Errors: TClientError.
void RequireReadableOnce(const std::vector<TInventorySources>& inventories, const std::vector<std::string>& schemas,
                         const std::string& rules);

}  // namespace NORVZEL20

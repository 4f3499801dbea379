#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The paths without those that lead to the same file as an earlier one, by the same name, a link or a hard link. Each name that is
/// dropped gets one note on the console. Repeated "-" stay, because standard input cannot be read twice. Errors: std::bad_alloc.
std::vector<std::string> DropRepeatedFiles(const std::vector<std::string>& paths, IConsole& console);

/// The inventories without repeated files inside of one, and without those that consist of the same files as an earlier one, with
/// notes as above. Different inventories may share files.
/// Errors: TClientError, without notes about inventories, if there were at least `fewest` of them and fewer remain.
std::vector<TInventorySources> DropRepeatedInventories(std::vector<TInventorySources> inventories, std::size_t fewest,
                                                       IConsole& console);

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The paths without those that lead to the same file as an earlier one, by the same name, a link or a hard link. Each name that is
/// dropped gets one note on the console. Repeated "-" stay, because standard input cannot be read twice.
/// Errors: TClientError, without notes, if there were at least `fewest` paths and fewer remain.
std::vector<std::string> DropRepeatedFiles(const std::vector<std::string>& paths, std::size_t fewest, IConsole& console);

}  // namespace NORVZEL20

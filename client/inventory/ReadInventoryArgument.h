#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Reads an argument of the form `[LABEL=]SOURCE[,SOURCE...]`; a source is a file, a folder or "-" for standard input.
///
/// The path of something that exists is taken as that path, whatever commas and equals signs it has. A label has neither a comma
/// nor a slash in it. A folder stands for the ordinary files in it, in ascending order of their names. Hidden files, links and what
/// is in folders below are left out; a note on the console names what else was left out but hidden files. Errors: TClientError for
/// an empty label or source, and for a folder without files. Files need not exist.
TInventorySources ReadInventoryArgument(const std::string& argument, IConsole& console);

/// The files of a list `SOURCE[,SOURCE...]`, likewise.
std::vector<std::string> ReadSourceList(const std::string& text, IConsole& console);

}  // namespace NORVZEL20

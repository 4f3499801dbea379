#pragma once

#include <CLI/CLI.hpp>
#include <string>

#include "client/inventory/TLoadingOptions.h"

namespace NORVZEL20 {

/// Adds the options that say how inventories are loaded, the same ones for every command. `loading` is filled while the command
/// line is parsed. It must live as long as the command.
///
/// `schemaNames` are the names of the option that gives declarations, the one for messages first.
void AddLoadingOptions(CLI::App* command, TLoadingOptions& loading, const std::string& schemaNames);

}  // namespace NORVZEL20

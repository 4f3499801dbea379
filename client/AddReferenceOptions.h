#pragma once

#include <CLI/CLI.hpp>

#include "client/commands/CompareCommand.h"

namespace NORVZEL20 {

/// Adds the options that say what inventories are compared with, and who is odd among them. `compare` is filled while the command
/// line is parsed. It must live as long as the command.
void AddReferenceOptions(CLI::App* command, TCompareOptions& compare);

}  // namespace NORVZEL20

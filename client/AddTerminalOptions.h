#pragma once

#include <CLI/CLI.hpp>

#include "client/commands/CompareCommand.h"

namespace NORVZEL20 {

/// Adds the options that say how much is shown on a terminal, and in which colours. `options` is filled while the command line is
/// parsed. It must live as long as the command.
void AddTerminalOptions(CLI::App* command, TCompareOptions& options);

}  // namespace NORVZEL20

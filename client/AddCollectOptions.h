#pragma once

#include <CLI/CLI.hpp>

#include "client/commands/CollectCommand.h"

namespace NORVZEL20 {

/// Adds the options of `collect`. `options` is filled while the command line is parsed. It must live as long as the command.
void AddCollectOptions(CLI::App* command, TCollectOptions& options);

}  // namespace NORVZEL20

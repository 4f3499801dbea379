#pragma once

#include <CLI/CLI.hpp>

#include "client/commands/CollectFromCommand.h"

namespace NORVZEL20 {

/// Adds the options of `collect` that are about a server: --from and those that need it. Of the options that the command has
/// already, --output goes with them, and the others do not. Errors: std::bad_alloc.
void AddCollectFrom(CLI::App* command, TCollectFromOptions& options);

}  // namespace NORVZEL20

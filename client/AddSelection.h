#pragma once

#include <CLI/CLI.hpp>
#include <string>

#include "client/commands/CompareCommand.h"

namespace NORVZEL20 {

/// Adds the options that select what is compared and what is shown of it. `options` is filled while the command line is parsed. It
/// must live as long as the command.
void AddSelection(CLI::App* command, TCompareOptions& options);

/// Adds the option that names a file for rules; likewise.
void AddSaveRules(CLI::App* command, std::string& path);

}  // namespace NORVZEL20

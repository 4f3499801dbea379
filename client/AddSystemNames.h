#pragma once

#include <CLI/CLI.hpp>
#include <string>
#include <vector>

#include "client/inventory/TSystemNames.h"

namespace NORVZEL20 {

/// Adds the options that say by which names inventories call their own systems. `names` is filled while the command line is parsed.
/// It must live as long as the command.
void AddSystemNames(CLI::App* command, TSystemNames& names);

/// The arguments with `--self NAME` as `--self=NAME`, if NAME can be the name of a property and is no file: CLI11 cannot tell the
/// value of an option that may be without one from the argument behind it.
std::vector<std::string> JoinSelf(const std::vector<std::string>& arguments);

}  // namespace NORVZEL20

#pragma once

#include <CLI/CLI.hpp>

#include "client/baseline/ApplyBaseline.h"

namespace NORVZEL20 {

/// Adds the options that accept differences and compare with accepted ones. `options` is filled while the command line is parsed.
/// It must live as long as the command.
void AddBaseline(CLI::App* command, TBaselineOptions& options);

}  // namespace NORVZEL20

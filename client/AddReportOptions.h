#pragma once

#include <CLI/CLI.hpp>

#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// Adds the options that say how a comparison is shown as text. `text` is filled while the command line is parsed. It must live as
/// long as the command.
void AddReportOptions(CLI::App* command, TTextOptions& text);

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// What `cimdelta check` was asked.
struct TCheckOptions {
    std::string rules;
    std::vector<std::string> schemas;  ///< inventories, the reference first; at least one
    std::string output;                ///< empty: standard output
};

/// Tells what a rules file says and does. Returns 0. Errors: TClientError, also for rules that a comparison would not accept.
int RunCheck(const TCheckOptions& options, IConsole& console);

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// What `cimdelta explain` was asked.
struct TExplainOptions {
    std::string element;  ///< a class, or a class and a property with a dot between them
    std::string rules;
    std::vector<std::string> schemas;  ///< inventories, the reference first; at least one
    std::string output;                ///< empty: standard output
};

/// Tells which rule decides how a class or a property is treated. Returns 0. Errors: TClientError.
int RunExplain(const TExplainOptions& options, IConsole& console);

}  // namespace NORVZEL20

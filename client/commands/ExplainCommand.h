#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The arguments of `cimdelta explain`.
struct TExplainOptions {
    std::string element;                     ///< a class, or a class and a property with a dot between them
    std::string rules;                       ///< empty: everything is compared
    std::vector<TInventorySources> schemas;  ///< inventories, the reference first; at least one
    std::string output;                      ///< empty: standard output
    bool strictSchema = false;               ///< whether the inventories are left as they are
    TLoadingOptions loading;
};

/// Writes which rule decides how a class or a property is treated. Returns kExitSuccess (0). Errors: TClientError.
int RunExplain(const TExplainOptions& options, IConsole& console);

}  // namespace NORVZEL20

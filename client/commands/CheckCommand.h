#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The arguments of `cimdelta check`.
struct TCheckOptions {
    std::string rules;
    std::vector<TInventorySources> schemas;  ///< inventories, the reference first; none: only what needs no inventory is checked
    std::string output;                      ///< empty: standard output
    bool strictSchema = false;               ///< whether the inventories are left as they are
    TLoadingOptions loading;
};

/// Writes what a rules file says and what follows from it. Returns kExitSuccess (0). Errors: TClientError, also for rules that a
/// comparison would not accept.
int RunCheck(const TCheckOptions& options, IConsole& console);

}  // namespace NORVZEL20

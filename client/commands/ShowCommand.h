#pragma once

#include <string>

#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"
#include "client/report/EOutputFormat.h"

namespace NORVZEL20 {

/// The arguments of `cimdelta show`.
struct TShowOptions {
    TInventorySources inventory;
    std::string className;  ///< empty: the classes are listed
    EOutputFormat format = EOutputFormat::kText;
    std::string output;  ///< empty: standard output
    TLoadingOptions loading;
};

/// Writes what an inventory holds: its classes, or the instances of one class and those below it. Returns kExitSuccess (0).
/// Errors: TClientError.
int RunShow(const TShowOptions& options, IConsole& console);

}  // namespace NORVZEL20

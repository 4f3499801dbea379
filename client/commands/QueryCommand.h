#pragma once

#include <string>

#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"
#include "client/report/EOutputFormat.h"

namespace NORVZEL20 {

/// The arguments of `cimdelta query`.
struct TQueryOptions {
    std::string query;
    TInventorySources inventory;
    EOutputFormat format = EOutputFormat::kText;
    std::string output;  ///< empty: standard output
    TLoadingOptions loading;
};

/// Writes the instances of an inventory that match a query in WQL. Returns kExitSuccess (0). Errors: TClientError.
int RunQuery(const TQueryOptions& options, IConsole& console);

}  // namespace NORVZEL20

#include "client/commands/QueryCommand.h"

#include "client/inventory/CollectObjects.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/report/InstanceListing.h"
#include "client/report/TResultOutput.h"
#include "embedded/query/TQuery.h"
#include "embedded/query/TQueryError.h"

namespace NORVZEL20 {

int RunQuery(const TQueryOptions& options, IConsole& console)
{
    try {
        // Parsed first: a wrong query is reported without waiting for the inventory.
        const TQuery query("WQL", options.query);
        const TInventory inventory = TInventoryLoader(console, options.loading).LoadOne(options.inventory);
        const auto instances = Collect<ICIMInstance>([&](const auto& callback) { query.Execute(*inventory.ns, callback); });
        DeliverResult(console, options.output, WriteInstances(inventory, instances, query.GetProperties(), options.format));
    } catch (const TQueryError& error) {
        throw TClientError(error.what());
    }
    return kExitSuccess;
}

}  // namespace NORVZEL20

#include "client/commands/QueryCommand.h"

#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/report/InstanceListing.h"
#include "client/report/ResultOutput.h"
#include "embedded/query/TQuery.h"
#include "embedded/query/TQueryError.h"
#include "host/TAddToVectorCallback.h"

namespace NORVZEL20 {

int RunQuery(const TQueryOptions& options, IConsole& console)
{
    try {
        // A query that is wrong is told before the inventory is loaded.
        const TQuery query("WQL", options.query);
        const TInventory inventory = TInventoryLoader(console).LoadOne(options.inventory);
        std::vector<boost::shared_ptr<ICIMInstance>> instances;
        query.Execute(*inventory.ns, TAddToVectorCallback<ICIMInstance>(&instances));
        DeliverResult(console, options.output, WriteInstances(inventory, instances, query.GetProperties(), options.format));
    } catch (const TQueryError& error) {
        throw TClientError(error.what());
    }
    return kExitSuccess;
}

}  // namespace NORVZEL20

#include "client/commands/CheckCommand.h"

#include "client/inventory/CompleteInventories.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/report/ResultOutput.h"
#include "client/report/TRulesListing.h"

namespace NORVZEL20 {

int RunCheck(const TCheckOptions& options, IConsole& console)
{
    std::vector<TInventory> inventories = TInventoryLoader(console).Load(options.schemas);
    CompleteInventories(inventories, console);
    DeliverResult(console, options.output, TRulesListing(options.rules, inventories.front()).WriteCheck());
    return kExitSuccess;
}

}  // namespace NORVZEL20

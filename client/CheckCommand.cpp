#include "client/CheckCommand.h"

#include "client/CompleteInventories.h"
#include "client/ResultOutput.h"
#include "client/TInventoryLoader.h"
#include "client/TRulesListing.h"

namespace NORVZEL20 {

int RunCheck(const TCheckOptions& options, IConsole& console)
{
    std::vector<TInventory> inventories = TInventoryLoader(console).Load(options.schemas);
    CompleteInventories(inventories, console);
    DeliverResult(console, options.output, TRulesListing(options.rules, inventories.front()).WriteCheck());
    return 0;
}

}  // namespace NORVZEL20

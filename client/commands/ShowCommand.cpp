#include "client/commands/ShowCommand.h"

#include "client/inventory/CollectObjects.h"
#include "client/inventory/RequireClass.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/report/InstanceListing.h"
#include "client/report/TResultOutput.h"

namespace NORVZEL20 {

namespace {

std::string Write(const TInventory& inventory, const TShowOptions& options)
{
    if (options.className.empty()) {
        return WriteClasses(inventory, options.format);
    }
    return WriteInstances(inventory, InstancesOfTree(*RequireClass(inventory, options.className)), {}, options.format);
}

}  // namespace

int RunShow(const TShowOptions& options, IConsole& console)
{
    const TInventory inventory = TInventoryLoader(console, options.loading).LoadOne(options.inventory);
    const std::string text = Write(inventory, options);
    if (text.empty() && options.className.empty()) {
        console.Say("cimdelta: " + inventory.label + ": has no class, only qualifiers");
    }
    DeliverResult(console, options.output, text);
    return kExitSuccess;
}

}  // namespace NORVZEL20

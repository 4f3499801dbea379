#include "client/commands/ShowCommand.h"

#include "client/inventory/CollectObjects.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/report/InstanceListing.h"
#include "client/report/ResultOutput.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

std::string WriteClass(const TInventory& inventory, const TShowOptions& options)
{
    const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(options.className);
    if (!cls) {
        throw TClientError(inventory.path + ": declares no class " + EscapeForDisplay(options.className) + "; cimdelta show " +
                           inventory.path + " lists those it declares");
    }
    return WriteInstances(inventory, InstancesOfTree(*cls), {}, options.format);
}

}  // namespace

int RunShow(const TShowOptions& options, IConsole& console)
{
    const TInventory inventory = TInventoryLoader(console).LoadOne(options.inventory);
    DeliverResult(console, options.output,
                  options.className.empty() ? WriteClasses(inventory, options.format) : WriteClass(inventory, options));
    return kExitSuccess;
}

}  // namespace NORVZEL20

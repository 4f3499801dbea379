#include "client/commands/ShowCommand.h"

#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/report/InstanceListing.h"
#include "client/report/ResultOutput.h"
#include "client/text/DisplayText.h"
#include "host/TAddToVectorCallback.h"

namespace NORVZEL20 {

namespace {

std::string WriteClass(const TInventory& inventory, const TShowOptions& options)
{
    const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(options.className);
    if (!cls) {
        throw TClientError(inventory.path + ": declares no class " + EscapeForDisplay(options.className) + "; cimdelta show " +
                           inventory.path + " lists those it declares");
    }
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), true, TCallContext());
    return WriteInstances(inventory, instances, {}, options.format);
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

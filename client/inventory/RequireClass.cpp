#include "client/inventory/RequireClass.h"

#include "client/files/TInputFile.h"
#include "client/inventory/TSuggestedCommand.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

boost::shared_ptr<TInMemClass> RequireClass(const TInventory& inventory, const std::string& name)
{
    const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(name);
    if (!cls) {
        throw TClientError(NameOfInput(inventory.path) + ": declares no class " + EscapeForDisplay(name) +
                           TSuggestedCommand("show").AddInventory(inventory).Advise("lists those it declares"));
    }
    return cls;
}

}  // namespace NORVZEL20

#include "client/commands/CheckCommand.h"

#include "client/inventory/CompleteInventories.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/report/TResultOutput.h"
#include "client/report/TRulesListing.h"
#include "client/rules/ReadRules.h"

namespace NORVZEL20 {

int RunCheck(const TCheckOptions& options, IConsole& console)
{
    const std::optional<TRulesText> rules = ReadRulesIfAny(options.rules);
    std::vector<TInventory> inventories = TInventoryLoader(console, options.loading).Load(options.schemas);
    std::vector<TSchemaNote> notes;
    if (!options.strictSchema && !inventories.empty()) {
        notes = CompleteInventories(inventories);
    }
    DeliverResult(console, options.output, TRulesListing(*rules, inventories, notes, options.strictSchema).WriteCheck());
    return kExitSuccess;
}

}  // namespace NORVZEL20

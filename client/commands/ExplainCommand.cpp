#include "client/commands/ExplainCommand.h"

#include "client/inventory/CompleteInventories.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/report/ResultOutput.h"
#include "client/report/TRulesListing.h"
#include "client/rules/MadeRules.h"
#include "client/rules/ReadRules.h"

namespace NORVZEL20 {

int RunExplain(const TExplainOptions& options, IConsole& console)
{
    const std::optional<TRulesText> rules = ReadRulesFor(options.schemas, options.rules);
    std::vector<TInventory> inventories = TInventoryLoader(console).Load(options.schemas);
    std::vector<TSchemaNote> notes;
    if (!options.strictSchema) {
        notes = CompleteInventories(inventories, console);
    }
    TRulesListing listing(rules ? *rules : TRulesText{"", MakeRulesForEverything(inventories, notes), true}, inventories, notes,
                          options.strictSchema);
    const std::size_t dot = options.element.find('.');
    DeliverResult(console, options.output,
                  dot == std::string::npos
                      ? listing.WriteExplanation(options.element)
                      : listing.WriteExplanation(options.element.substr(0, dot), options.element.substr(dot + 1)));
    return kExitSuccess;
}

}  // namespace NORVZEL20

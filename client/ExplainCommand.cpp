#include "client/ExplainCommand.h"

#include "client/CompleteInventories.h"
#include "client/ResultOutput.h"
#include "client/TInventoryLoader.h"
#include "client/TRulesListing.h"

namespace NORVZEL20 {

int RunExplain(const TExplainOptions& options, IConsole& console)
{
    std::vector<TInventory> inventories = TInventoryLoader(console).Load(options.schemas);
    CompleteInventories(inventories, console);
    TRulesListing listing(options.rules, inventories.front());
    const std::size_t dot = options.element.find('.');
    DeliverResult(console, options.output,
                  dot == std::string::npos
                      ? listing.WriteExplanation(options.element)
                      : listing.WriteExplanation(options.element.substr(0, dot), options.element.substr(dot + 1)));
    return 0;
}

}  // namespace NORVZEL20

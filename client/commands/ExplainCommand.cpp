#include "client/commands/ExplainCommand.h"

#include "client/inventory/CompleteInventories.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/report/TResultOutput.h"
#include "client/report/TRulesListing.h"
#include "client/rules/MadeRules.h"
#include "client/rules/ReadRules.h"

namespace NORVZEL20 {

namespace {

// The parts of CLASS or CLASS.PROPERTY.
struct TAskedElement {
    std::string className;
    std::optional<std::string> property;
};

TAskedElement Split(const std::string& text)
{
    const std::size_t dot = text.find('.');
    if (dot == std::string::npos) {
        return {text, std::nullopt};
    }
    if (dot == 0 || dot + 1 == text.size()) {
        throw TClientError(text + " is neither CLASS nor CLASS.PROPERTY");
    }
    return {text.substr(0, dot), text.substr(dot + 1)};
}

}  // namespace

int RunExplain(const TExplainOptions& options, IConsole& console)
{
    const TAskedElement element = Split(options.element);
    const std::optional<TRulesText> rules = ReadRulesIfAny(options.rules);
    std::vector<TInventory> inventories = TInventoryLoader(console, options.loading).Load(options.schemas);
    std::vector<TSchemaNote> notes;
    if (!options.strictSchema) {
        notes = CompleteInventories(inventories);
    }
    TRulesListing listing(rules ? *rules : TRulesText{"", MakeRulesForEverything(inventories, notes), true}, inventories, notes,
                          options.strictSchema);
    DeliverResult(console, options.output,
                  element.property ? listing.WriteExplanation(element.className, *element.property)
                                   : listing.WriteExplanation(element.className));
    return kExitSuccess;
}

}  // namespace NORVZEL20

#include "client/commands/NoiseCommand.h"

#include <boost/algorithm/string/join.hpp>

#include "client/comparison/TComparison.h"
#include "client/inventory/AlignSystemNames.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/noise/FindNoise.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/report/DescribeNothingCompared.h"
#include "client/report/NoiseJson.h"
#include "client/report/NoiseText.h"
#include "client/report/TResultOutput.h"
#include "client/rules/ReadRules.h"
#include "client/text/Counted.h"

namespace NORVZEL20 {

namespace {

void SaveNoise(const TNoise& noise, const TNoiseOptions& options, IConsole& console)
{
    if (options.savedRules.empty()) {
        return;
    }
    std::vector<std::string> heading{"Saved by cimdelta noise: leaves out what differs between these inventories of one system.",
                                     "  " + boost::algorithm::join(noise.before.paths, " ")};
    if (!noise.before.areRulesMade) {
        heading.push_back("Everything else is as in " + noise.before.rules + ".");
    }
    if (const std::size_t rest = noise.after.differences->GetCounts().GetTotal()) {
        heading.push_back(Counted(rest, "difference is", "differences are") + " not explained and stay.");
    }
    TRulesDraft draft = noise.draft;
    for (const TNoiseRule& rule : noise.rules) {
        draft.Remark(rule.position, (rule.name.empty() ? rule.className : rule.name) + ": " + NoiseEvidence(noise, rule));
    }
    DeliverResult(console, options.savedRules, draft.Write(heading));
}

}  // namespace

int RunNoise(const TNoiseOptions& options, IConsole& console)
{
    CheckSystemNames(options.systems);
    const std::optional<TRulesText> rules = ReadRulesIfAny(options.rules);
    std::vector<TInventory> inventories = TInventoryLoader(console, options.loading).Load(options.inventories);
    AlignSystemNames(inventories, options.systems);
    TComparison comparison(inventories, console);
    comparison.Prepare(rules, options.strictSchema);
    const TNoise noise = FindNoise(comparison, inventories);
    if (noise.before.coverage.IsNothingCompared()) {
        throw TClientError(DescribeNothingCompared(noise.before, inventories, options.rules, options.strictSchema));
    }
    SaveNoise(noise, options, console);
    TTextOptions text = options.text;
    text.isColored = console.IsColored() && IsStandardOutput(options.output);
    DeliverResult(console, options.output,
                  options.format == EOutputFormat::kJson ? WriteNoiseJson(noise) : WriteNoiseText(noise, text));
    return noise.before.differences->GetCounts().GetTotal() == 0 ? kExitSuccess : kExitDifferences;
}

}  // namespace NORVZEL20

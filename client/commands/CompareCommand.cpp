#include "client/commands/CompareCommand.h"

#include "client/comparison/SeeFromMajority.h"
#include "client/comparison/TComparison.h"
#include "client/inventory/AlignSystemNames.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/process/TProgress.h"
#include "client/report/DescribeNothingCompared.h"
#include "client/report/TResultOutput.h"
#include "client/report/WriteReport.h"
#include "client/rules/ReadRules.h"

namespace NORVZEL20 {

namespace {

void Deliver(const TComparisonReport& report, const TCompareOptions& options, IConsole& console)
{
    TResultOutput output(console, options.output);
    {
        const TProgress progress(console, "writing the report");
        TTextOptions text = options.text;
        text.isColored = console.IsColored() && IsStandardOutput(options.output);
        WriteReport(report, options.format, text, [&output](std::string_view piece) { output.Write(piece); });
    }
    output.Deliver();
}

}  // namespace

int RunCompare(const TCompareOptions& options, IConsole& console)
{
    // Before the inventories, which may take long to load.
    CheckSystemNames(options.systems);
    const std::vector<TInventorySources> sources = options.reference.Apply(options.inventories, options.format);
    const std::optional<TRulesText> rules = ReadRulesIfAny(options.rules);
    std::vector<TInventory> inventories = TInventoryLoader(console, options.loading).Load(sources);
    AlignSystemNames(inventories, options.systems);
    TComparisonReport report = TComparison(inventories, console).Run(rules, options.strictSchema);
    if (!options.allowEmpty && report.coverage.IsNothingCompared()) {
        throw TClientError(DescribeNothingCompared(report, inventories, options.rules, options.strictSchema));
    }
    if (options.reference.WantsMajority()) {
        report = SeeFromMajority(report);
    }
    Deliver(report, options, console);
    return report.differences->GetCounts().GetTotal() == 0 ? kExitSuccess : kExitDifferences;
}

}  // namespace NORVZEL20

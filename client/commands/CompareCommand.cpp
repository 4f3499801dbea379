#include "client/commands/CompareCommand.h"

#include "client/comparison/TComparison.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/report/CimXmlFormat.h"
#include "client/report/DescribeNothingCompared.h"
#include "client/report/JsonFormat.h"
#include "client/report/TResultOutput.h"
#include "client/report/TTextFormat.h"
#include "client/rules/ReadRules.h"

namespace NORVZEL20 {

namespace {

std::string Write(const TComparisonReport& report, EOutputFormat format, bool colored)
{
    switch (format) {
    case EOutputFormat::kJson:
        return WriteJsonReport(report);
    case EOutputFormat::kNdjson:
        return WriteNdjsonReport(report);
    case EOutputFormat::kCimXml:
        return WriteCimXmlReport(report);
    case EOutputFormat::kText:
        break;
    }
    return TTextFormat(report, colored).Write();
}

}  // namespace

int RunCompare(const TCompareOptions& options, IConsole& console)
{
    std::vector<std::string> paths(1, options.reference);
    paths.insert(paths.end(), options.others.begin(), options.others.end());
    // Before the inventories, which may take long to load.
    const std::optional<TRulesText> rules = ReadRulesFor(paths, options.rules);
    std::vector<TInventory> inventories = TInventoryLoader(console).Load(paths);
    const TComparisonReport report = TComparison(inventories, console).Run(rules, options.strictSchema);
    if (!options.allowEmpty && report.coverage.IsNothingCompared()) {
        throw TClientError(DescribeNothingCompared(report, options.rules, options.strictSchema));
    }
    DeliverResult(console, options.output, Write(report, options.format, console.IsColored() && IsStandardOutput(options.output)));
    return report.differences.empty() ? kExitSuccess : kExitDifferences;
}

}  // namespace NORVZEL20

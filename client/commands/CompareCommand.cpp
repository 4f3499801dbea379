#include "client/commands/CompareCommand.h"

#include <algorithm>
#include <utility>

#include "client/baseline/ReadBaseline.h"
#include "client/commands/SaveRules.h"
#include "client/commands/TCountingDifferences.h"
#include "client/commands/WriteReport.h"
#include "client/comparison/SeeFromMajority.h"
#include "client/comparison/TComparison.h"
#include "client/inventory/AlignSystemNames.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/process/TProgress.h"
#include "client/report/DescribeNothingCompared.h"
#include "client/report/TResultOutput.h"
#include "client/rules/ReadRules.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLeastWidth = 40;
constexpr std::size_t kMostLinesOnTerminal = 200;

bool IsBesideBaseline(const TBaselineOptions& options)
{
    return !options.accept.empty() || !options.baseline.empty();
}

// What needs no file to be found wrong.
void CheckOptions(const TCompareOptions& options, const IConsole& console)
{
    if (options.format == EOutputFormat::kHtml && !options.isQuiet && IsStandardOutput(options.output) && console.IsTerminal()) {
        throw TClientError(
            "-o html writes a page for a browser, and standard output is a terminal; name a file with --output FILE");
    }
    if (options.format == EOutputFormat::kCimXml && IsBesideBaseline(options.baseline)) {
        throw TClientError("-o cimxml writes the records of all differences, so it cannot be combined with --accept or --baseline; "
                           "choose another format");
    }
    if (options.format == EOutputFormat::kCimXml && !options.only.kinds.empty()) {
        throw TClientError("--only cannot be used with -o cimxml, which has all records of the comparison; leave one of them out");
    }
    if (!options.baseline.accept.empty() && !options.only.kinds.empty()) {
        throw TClientError("--only cannot be used with --accept, which keeps all differences, shown or not; leave one of them out");
    }
    CheckReason(options.baseline.reason);
    if (options.text.isSummary && options.format != EOutputFormat::kText) {
        throw TClientError("--summary is for text reports; leave it out, or -o, whose reports have a summary of their own");
    }
}

std::optional<TBaseline> ReadBaselineIfNamed(const TBaselineOptions& options)
{
    if (!options.baseline.empty()) {
        return ReadBaseline(options.baseline);
    }
    return options.accept.empty() ? std::nullopt : std::make_optional(ReadBaselineIfAny(options.accept));
}

// Whether properties are asked for by their names, as reports advise for those of large groups. These are then shown whole.
bool AreNamed(const std::vector<std::string>& properties)
{
    return !properties.empty() && std::all_of(properties.begin(), properties.end(), [](const std::string& name) {
        return name.find_first_of("*?") == std::string::npos;
    });
}

// With the colours, the width and the number of lines that fit where the report goes.
TTextOptions TextOptions(const TCompareOptions& options, const IConsole& console)
{
    TTextOptions text = options.text;
    const bool isOnConsole = IsStandardOutput(options.output);
    text.isColored =
        options.color == EColorChoice::kAlways || (options.color == EColorChoice::kAuto && isOnConsole && console.IsColored());
    if (const std::size_t width = isOnConsole ? console.GetWidth() : 0; width > 0) {
        text.width = std::max(width, kLeastWidth);
    }
    text.hasWholeGroups = !options.selection.properties.empty();
    text.isLimitChosen = text.mostLines > 0;
    if (!text.isLimitChosen && !AreNamed(options.selection.properties) && isOnConsole && console.IsTerminal()) {
        text.mostLines = kMostLinesOnTerminal;
    }
    return text;
}

// What is saved is kept before the report is seen, and after it could be made: if either fails, the report is not seen, and if the
// report cannot be made, nothing is kept.
void Deliver(TComparisonReport& report, const TCompareOptions& options, const std::optional<TBaseline>& accepted, IConsole& console)
{
    TResultOutput output(console, options.output);
    const bool isWritten = !options.isQuiet || !IsStandardOutput(options.output);
    if (isWritten) {
        const TCountingDifferences counting(report);
        const TProgress progress(console, "writing the report", [&counting] { return counting.Describe(); });
        WriteReport(report, options.format, TextOptions(options, console),
                    [&output](std::string_view piece) { output.Write(piece); });
    }
    SaveRules(options.savedRules, report, options.selection, console);
    if (accepted) {
        DeliverResult(console, options.baseline.accept, accepted->ToText());
    }
    if (isWritten) {
        output.Deliver();
    }
}

void ShowOnly(TComparisonReport& report, const TOnlyShown& only)
{
    if (!only.kinds.empty()) {
        const auto shown = std::make_shared<TOnlyKinds>(report.differences, only.kinds);
        report.notShown = {shown->CountOthers(), only.option};
        report.differences = shown;
    }
}

}  // namespace

int RunCompare(const TCompareOptions& options, IConsole& console)
{
    // Before the inventories, which may take long to load.
    CheckOptions(options, console);
    CheckSystemNames(options.systems);
    TReferenceChoice reference = options.reference;
    reference.isMajority = options.text.showsOutliers;
    if (reference.WantsMajority() && options.format == EOutputFormat::kCimXml) {
        throw TClientError("the records of -o cimxml name the differences from an inventory, not from the majority; use another "
                           "format, or name an inventory with --reference");
    }
    const std::vector<TInventorySources> sources = reference.Apply(options.inventories);
    const std::optional<TRulesText> rules = ReadRulesIfAny(options.rules);
    std::optional<TBaseline> baseline = ReadBaselineIfNamed(options.baseline);
    std::vector<TInventory> inventories = TInventoryLoader(console, options.loading).Load(sources);
    AlignSystemNames(inventories, options.systems);
    TComparisonReport report = TComparison(inventories, console).Run(rules, options.strictSchema, options.selection);
    if (!options.allowEmpty && report.coverage.IsNothingCompared()) {
        throw TClientError(DescribeNothingCompared(report, inventories, options.rules, options.strictSchema));
    }
    if (reference.WantsMajority()) {
        report = SeeFromMajority(report);
    }
    std::optional<TBaseline> accepted;
    if (baseline) {
        accepted = ApplyBaseline(report, std::move(*baseline), options.baseline);
    }
    ShowOnly(report, options.only);
    Deliver(report, options, accepted, console);
    return accepted || report.differences->GetCounts().GetTotal() == 0 ? kExitSuccess : kExitDifferences;
}

}  // namespace NORVZEL20

// A report with each kind of rule:
//
//   45 differences between boot1 and boot2, boot3; 4 rules leave out all but 2 of them
//
//   --exclude Processor.Load      changed in 4 of 4 instances in 2 of 2 comparisons: 12 -> 57 (boot2) / 3 (boot3)
//   --exclude Session             no instance stays: 6 come and go in 2 of 2 comparisons
//   --exclude-key Process.Handle  24 of 26 instances match without it in 2 of 2 comparisons
//
//   Not explained:
//   Process  -1 +1 instances come and go; boot1 has 13
//
//   21 instances of each in 4 classes compared
#include "client/report/NoiseText.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>

#include "client/findings/DeclaredWords.h"
#include "client/report/ChangeText.h"
#include "client/report/DescribeAgreement.h"
#include "client/report/DisplayLabels.h"
#include "client/report/NamesOf.h"
#include "client/report/ShortCoverage.h"
#include "client/report/TextColors.h"
#include "client/report/TextCoverage.h"
#include "client/text/Counted.h"
#include "client/text/CutText.h"
#include "client/text/DisplayText.h"
#include "client/text/QuoteForShell.h"

namespace NORVZEL20 {

namespace {

std::size_t CountDifferences(const TComparisonReport& report)
{
    return report.differences->GetCounts().GetTotal();
}

std::string NoiseVerdict(const TNoise& noise)
{
    const std::size_t before = CountDifferences(noise.before);
    if (before == 0) {
        return DescribeAgreement(noise.before);
    }
    const std::size_t after = CountDifferences(noise.after);
    const std::string rules = Counted(noise.rules.size(), "rule leaves", "rules leave");
    return Counted(before, "difference") + " between " + DisplayLabels(noise.before, {0}) + " and " + DisplayOthers(noise.before) +
           "; " +
           (noise.rules.empty() ? "no rule was found that leaves them out"
            : after == 0        ? rules + " all of them out"
                                : rules + " out all but " + std::to_string(after));
}

// "changed in 4 of 4 instances in 2 of 2 comparisons"
std::string Comparisons(const TNoise& noise, const TNoiseRule& rule)
{
    return " in " + std::to_string(rule.comparisons) + " of " + Counted(noise.before.labels.size() - 1, "comparison");
}

std::string Table(const std::vector<std::pair<std::string, std::string>>& rows)
{
    std::size_t width = 0;
    for (const auto& row : rows) {
        width = std::max(width, row.first.size());
    }
    std::string text;
    for (const auto& [left, right] : rows) {
        text += left + std::string(width - left.size(), ' ') + "  " + right + "\n";
    }
    return text;
}

// "-1 +2 instances come and go; boot1 has 13"
std::string Rest(const TNoise& noise, const TUnexplained& rest)
{
    std::vector<std::string> parts;
    std::string instances;
    if (rest.counts.onlyInReference > 0) {
        instances = "-" + std::to_string(rest.counts.onlyInReference) + " ";
    }
    if (rest.counts.onlyInOthers > 0) {
        instances += "+" + std::to_string(rest.counts.onlyInOthers) + " ";
    }
    if (!instances.empty()) {
        const bool isOne = rest.counts.onlyInReference + rest.counts.onlyInOthers == 1;
        parts.push_back(instances + (isOne ? "instance comes or goes" : "instances come and go") + "; " +
                        DisplayLabels(noise.before, {0}) + " has " + std::to_string(rest.instances));
    }
    if (rest.counts.changedValues > 0) {
        parts.push_back(Counted(rest.counts.changedValues, "changed value"));
    }
    return boost::algorithm::join(parts, "; ");
}

// A long change is cut: it only shows what kind of change it is.
std::string Example(const TNoise& noise, const TNoiseRule& rule)
{
    constexpr std::size_t kLongestExample = 60;
    const TValueWords words = DeclaredWords(*noise.before.inventories, rule.className, rule.example.property);
    TChangeStyle style;
    style.isPair = noise.before.labels.size() == 2;
    style.words = &words;
    return CutText(ChangeText(rule.example, NamesOf(noise.before), style), kLongestExample);
}

}  // namespace

std::string NoiseOption(const TNoiseRule& rule)
{
    switch (rule.kind) {
    case TNoiseRule::kKey:
        return "--exclude-key " + QuoteForShell(rule.className + "." + rule.name);
    case TNoiseRule::kProperty:
        return "--exclude " + QuoteForShell(rule.className + "." + rule.name);
    default:
        return "--exclude " + QuoteForShell(rule.className);
    }
}

std::string NoiseEvidence(const TNoise& noise, const TNoiseRule& rule)
{
    const std::string share = std::to_string(rule.affected) + " of " + Counted(rule.of, "instance");
    const std::string alone = rule.isForTree ? "" : " (the class alone, not those below it)";
    switch (rule.kind) {
    case TNoiseRule::kKey:
        return share + (rule.of == 1 ? " matches" : " match") + " without it" + Comparisons(noise, rule) + alone;
    case TNoiseRule::kProperty:
        return "changed in " + share + Comparisons(noise, rule) + alone + ": " + Example(noise, rule);
    default:
        return "no instance stays: " + std::to_string(rule.affected) + (rule.affected == 1 ? " comes or goes" : " come and go") +
               Comparisons(noise, rule) + alone;
    }
}

std::string WriteNoiseText(const TNoise& noise, const TTextOptions& options)
{
    std::string text = Paint(options.isColored, kBold, NoiseVerdict(noise)) + "\n";
    std::vector<std::pair<std::string, std::string>> rows;
    for (const TNoiseRule& rule : noise.rules) {
        rows.emplace_back(EscapeForDisplay(NoiseOption(rule)), NoiseEvidence(noise, rule));
    }
    text += (rows.empty() ? "" : "\n") + Table(rows);
    if (std::any_of(noise.rules.begin(), noise.rules.end(), [](const TNoiseRule& rule) { return !rule.isForTree; })) {
        text += "The options reach the classes below a class as well, also where a rule is for the class alone; the rules that "
                "--save-rules writes do not.\n";
    }
    rows.clear();
    for (const TUnexplained& rest : noise.rest) {
        rows.emplace_back(EscapeForDisplay(rest.className), Rest(noise, rest));
    }
    text += (rows.empty() ? "" : "\nNot explained:\n") + Table(rows);
    return text + "\n" + (options.hasWholeCoverage ? WriteTextCoverage(noise.before) : WriteShortCoverage(noise.before));
}

}  // namespace NORVZEL20

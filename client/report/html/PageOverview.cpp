// The overview, with one element of each list:
//
//   { "verdict": "web01 against 7 others: 56 differences",
//     "counts": { "differences": 56, "onlyInReference": 2, "onlyInOthers": 1, "changedValues": 53, "changedInstances": 50 },
//     "notShown": "3 changed values not shown (--only +)", "reference": 0,
//     "inventories": [ { "label": "web01", "file": "web01.xml", "instances": 330, "namespace": "root/cimv2", "differences": 0 } ],
//     "classes": [ { "differences": 1, "onlyInReference": 0, "onlyInOthers": 0, "changedValues": 1, "changedInstances": 1,
//                    "name": "Disk", "compared": [ 5, 5 ], "byInventory": [ 0, 1 ], "instances": [ 0, 1 ] } ],
//     "comparedClasses": 9,
//     "sets": [ { "inventories": [ 1, 2 ], "text": "web02, web03" } ],
//     "findings": [ { "kind": 2, "class": 0, "property": "Size", "set": 1, "first": 0, "rows": 1, "changes": 1, "rarity": 1,
//                     "example": { "names": [ "sda" ], "contents": [], "reference": "500", "others": [ [ "250", 1 ] ],
//                                  "short": "" },
//                     "rule": { "what": "...", "place": "...", "xml": "..." } } ],
//     "rules": { "name": "rules.xml", "isMade": false, "options": "", "digest": "9f86...", "text": "..." },
//     "baseline": [ "2 differences are new ..." ], "coverage": [ "Compared: ..." ] }
//
// "compared", "byInventory" (differences) and "instances" have a number for each inventory. "contents" has the properties and
// values of an instance that came or went: [ "Size", "500" ]. The kinds are those of TDifference.
#include "client/report/html/PageOverview.h"

#include <boost/algorithm/string/classification.hpp>
#include <boost/algorithm/string/split.hpp>
#include <boost/algorithm/string/trim.hpp>
#include <map>

#include "client/report/BaselineText.h"
#include "client/report/DescribeAgreement.h"
#include "client/report/DescribeNotShown.h"
#include "client/report/NamesOf.h"
#include "client/report/TextCoverage.h"
#include "client/report/html/Sha256.h"
#include "client/report/html/TRuleProposals.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

std::string Verdict(const TComparisonReport& report)
{
    const std::size_t total = report.differences->GetCounts().GetTotal();
    if (total == 0) {
        return DescribeAgreement(report);
    }
    const std::string reference = DisplayLabel(report.labels[0]);
    const std::size_t others = report.labels.size() - 1;
    return others == 1 ? reference + " \u2192 " + DisplayLabel(report.labels[1]) + ": " + Counted(total, "difference")
                       : reference + " against " + std::to_string(others) + " others: " + Counted(total, "difference");
}

TJson CountsOf(const TDifferenceCounts& counts)
{
    return {{"differences", counts.GetTotal()},
            {"onlyInReference", counts.onlyInReference},
            {"onlyInOthers", counts.onlyInOthers},
            {"changedValues", counts.changedValues},
            {"changedInstances", counts.changedInstances}};
}

TJson InventoriesOf(const TComparisonReport& report, const TPageData& data)
{
    TJson inventories = TJson::array();
    for (std::size_t i = 0; i < report.labels.size(); ++i) {
        std::size_t differences = 0;
        for (const TPageClass& cls : data.classes) {
            differences += cls.differences[i];
        }
        inventories.push_back({{"label", DisplayLabel(report.labels[i])},
                               {"file", EscapeForDisplay(report.paths[i])},
                               {"instances", report.coverage.CountCompared(i)},
                               {"namespace", EscapeForDisplay(report.loads[i].namespaceName)},
                               {"differences", differences}});
    }
    return inventories;
}

TJson ClassesOf(const TComparisonReport& report, const TPageData& data)
{
    std::map<std::string, const TCoverage::TClass*> covered;
    for (const TCoverage::TClass& cls : report.coverage.classes) {
        covered[cls.name] = &cls;
    }
    TJson classes = TJson::array();
    for (const TPageClass& cls : data.classes) {
        const auto found = covered.find(cls.name);
        TJson json = CountsOf(cls.counts);
        json["name"] = EscapeForDisplay(cls.name);
        json["compared"] = found == covered.end() ? std::vector<std::size_t>(report.labels.size(), 0) : found->second->compared;
        json["byInventory"] = cls.differences;
        json["instances"] = cls.instances;
        classes.push_back(std::move(json));
    }
    return classes;
}

TJson SetsOf(const TComparisonReport& report, const TPageSets& sets)
{
    const TInventoryNames names = NamesOf(report);
    TJson list = TJson::array();
    for (std::uint32_t i = 0; i < sets.GetCount(); ++i) {
        const std::vector<std::size_t>& inventories = sets.Get(i);
        list.push_back({{"inventories", inventories}, {"text", inventories.empty() ? std::string() : names.List(inventories)}});
    }
    return list;
}

TJson ExampleOf(const TPageFinding::TExample& example)
{
    return {{"names", example.names},
            {"contents", example.contents},
            {"reference", example.reference},
            {"others", example.others},
            {"short", example.shortText}};
}

TJson RuleOf(TRuleProposals& proposals, const std::string& className, const TPageFinding& finding)
{
    const TRuleProposals::TProposal& rule = finding.kind == TDifference::kChanged
                                                ? proposals.LeaveOutProperty(className, finding.property)
                                                : proposals.LeaveOutClass(className);
    return {{"what", EscapeForDisplay(rule.what)}, {"place", EscapeForDisplay(rule.place)}, {"xml", rule.xml}};
}

TJson FindingsOf(const TComparisonReport& report, const TPageData& data)
{
    TRuleProposals proposals(report);
    TJson findings = TJson::array();
    for (const TPageFinding& finding : data.findings) {
        findings.push_back({{"kind", static_cast<int>(finding.kind)},
                            {"class", finding.classNumber},
                            {"property", EscapeForDisplay(finding.property)},
                            {"set", finding.set},
                            {"first", finding.firstRow},
                            {"rows", finding.rows},
                            {"changes", finding.changes},
                            {"rarity", finding.rarity},
                            {"example", ExampleOf(finding.example)},
                            {"rule", RuleOf(proposals, data.classes[finding.classNumber].name, finding)}});
    }
    return findings;
}

TJson LinesOf(std::string text)
{
    boost::algorithm::trim(text);
    std::vector<std::string> lines;
    if (!text.empty()) {
        boost::algorithm::split(lines, text, boost::algorithm::is_any_of("\n"));
    }
    return lines;
}

TJson BaselineOf(const TComparisonReport& report)
{
    TTextOptions options;
    options.isDetailed = true;
    return LinesOf(WriteBaselineText(report, options));
}

}  // namespace

TJson MakePageOverview(const TComparisonReport& report, const TPageData& data)
{
    TJson overview;
    overview["verdict"] = Verdict(report);
    overview["counts"] = CountsOf(report.differences->GetCounts());
    overview["notShown"] = DescribeNotShown(report);
    overview["reference"] = 0;
    overview["inventories"] = InventoriesOf(report, data);
    overview["classes"] = ClassesOf(report, data);
    overview["comparedClasses"] = report.coverage.CountComparedClasses();
    overview["sets"] = SetsOf(report, data.sets);
    overview["findings"] = FindingsOf(report, data);
    overview["rules"] = {{"name", EscapeForDisplay(report.rules)},
                         {"isMade", report.areRulesMade},
                         {"options", EscapeForDisplay(report.options)},
                         {"digest", Sha256Hex(report.options.empty() ? report.rulesText : report.meaning->GetText())},
                         {"text", report.areRulesMade ? std::string() : report.rulesText}};
    overview["baseline"] = BaselineOf(report);
    overview["coverage"] = LinesOf(WriteDetailedCoverage(report));
    return overview;
}

}  // namespace NORVZEL20

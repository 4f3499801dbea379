// The document, with one element of each list; every name and the order of the names are part of the format:
//
//   { "format": "cimdelta-comparison", "version": 1,
//     "inventories": [ { "label": "web01", "file": "web01.xml", "role": "reference", "instancesCompared": 2, "differences": 0 } ],
//     "summary": { "differences": 1, "onlyInReference": 0, "onlyInOthers": 0, "changedValues": 1, "changedInstances": 1,
//                  "instancesOnlyInOthers": 0, "everythingCompared": false, "nothingCompared": false,
//                  "classes": [ { "class": "Disk", "onlyInReference": 0, "onlyInOthers": 0, "changedValues": 1,
//                                 "changedInstances": 1 } ],
//                  "notShown": { "option": "--only +", "onlyInReference": 0, "onlyInOthers": 0, "changedValues": 3 } },
//     "groups": [ ... ],
//     "differences": [ ... ],
//     "coverage": { "classes": [ { "class": "Disk", "state": "compared", "instances": [ 1, 1 ], "propertiesLeftOut": [ "Model" ],
//                                  "excludedKeys": [], "sharingKeys": [ 0, 0 ], "instancesCompared": [ 1, 1 ],
//                                  "ignoredKeys": [], "sharingKeysWithoutPartner": [ 0, 0 ], "referencesReduced": false,
//                                  "referenceKeysLeftOut": [],
//                                  "leftOutReasons": [ { "property": "Model", "reason": "excludedByRules" } ] } ],
//                   "classesWithoutInstances": 0,
//                   "schema": [ { "kind": "propertyDeclared", "inventory": "web02", "asIn": "web01", "class": "Disk",
//                                 "property": "Model" } ],
//                   "badValues": [ { "inventory": "web02", "class": "Disk", "property": "Size", "values": 2, "takenAs": "null",
//                                    "first": { "text": "70000", "type": "uint16", "instance": "Disk.Id=\"sda\"",
//                                               "file": "web02.xml", "line": 12, "column": 40 } } ],
//                   "systemNames": [ { "inventory": "web02", "name": "web02", "comparedAs": "web01", "texts": 706,
//                                      "anotherSystem": 0,
//                                      "withinLongerTexts": [ { "key": "Port.Id", "texts": 2 } ] } ],
//                   "hints": [ { "kind": "systemName", "class": "Disk", "property": "SystemName", "instances": [ 1, 1 ] } ] } }
//
// A class with instances that cimdelta made ends with "madeIn": [ "web02" ]. A note may end with "before": "model", the spelling
// that was replaced, or with "declared": "Bag" and "declaredAsIn": "Ordered"; its kind decides, also whether it has "property".
//
// JsonGroups.cpp shows the groups, JsonDifference.cpp the differences. Lists of numbers have one for each inventory, the reference
// first. With a baseline, "baseline" stands in front of "coverage", as JsonBaseline.cpp shows it.
#include "client/report/JsonFormat.h"

#include "client/findings/CollectFindings.h"
#include "client/report/JsonBaseline.h"
#include "client/report/JsonCoverage.h"
#include "client/report/JsonDifference.h"
#include "client/report/JsonGroups.h"
#include "client/report/JsonValue.h"
#include "client/report/TJsonDocument.h"
#include "embedded/load/TLoadReport.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

TJson JsonOfSummary(const TComparisonReport& report, const TFindings& findings)
{
    const TDifferenceCounts& counts = report.differences->GetCounts();
    TJson summary = {{"differences", counts.GetTotal()},
                     {"onlyInReference", counts.onlyInReference},
                     {"onlyInOthers", counts.onlyInOthers},
                     {"changedValues", counts.changedValues},
                     {"changedInstances", counts.changedInstances},
                     {"instancesOnlyInOthers", counts.instancesOnlyInOthers},
                     {"everythingCompared", report.coverage.IsComplete()},
                     {"nothingCompared", report.coverage.IsNothingCompared()},
                     {"classes", JsonOfClassCounts(findings)}};
    if (!report.notShown.option.empty()) {
        const TDifferenceCounts& others = report.notShown.counts;
        summary["notShown"] = {{"option", report.notShown.option},
                               {"onlyInReference", others.onlyInReference},
                               {"onlyInOthers", others.onlyInOthers},
                               {"changedValues", others.changedValues}};
    }
    return summary;
}

const char* NamespaceOrigin(TLoadReport::ENamespaceOrigin origin)
{
    switch (origin) {
    case TLoadReport::kFromDocuments:
        return "document";
    case TLoadReport::kFromReferences:
        return "references";
    case TLoadReport::kFromOptions:
        return "option";
    default:
        return "default";
    }
}

TJson JsonOfInferred(const TLoadReport& loaded)
{
    TJson classes = TJson::array();
    for (const TLoadReport::TInferred& inferred : loaded.inferred) {
        classes.push_back({{"class", inferred.className}, {"keys", inferred.keys}});
    }
    return classes;
}

TJson JsonOfInventories(const TComparisonReport& report, const TFindings& findings)
{
    TJson inventories = TJson::array();
    for (std::size_t i = 0; i < report.labels.size(); ++i) {
        inventories.push_back({{"label", report.labels[i]},
                               {"file", report.paths[i]},
                               {"role", i == 0 ? "reference" : "other"},
                               {"instancesCompared", report.coverage.CountCompared(i)},
                               {"differences", findings.differences[i]},
                               {"namespace", report.loads[i].namespaceName},
                               {"namespaceFrom", NamespaceOrigin(report.loads[i].namespaceOrigin)},
                               {"inferredClasses", JsonOfInferred(report.loads[i])}});
    }
    return inventories;
}

// Groups hold no more than this of what is listed among the differences.
constexpr std::size_t kExamplesOfGroup = 8;

void AddFindings(TJsonDocument& document, const TComparisonReport& report)
{
    const TFindings findings = CollectFindings(report, kExamplesOfGroup);
    document.Add("inventories", JsonOfInventories(report, findings));
    document.Add("summary", JsonOfSummary(report, findings));
    document.StartList("groups");
    ForEachGroup(report, findings, [&document](const TJson& group) { document.AddElement(group); });
    document.EndList();
}

}  // namespace

void WriteJsonReport(const TComparisonReport& report, const TTextSink& sink)
{
    TJsonDocument document(sink);
    document.Add("format", "cimdelta-comparison");
    document.Add("version", 1);
    AddFindings(document, report);
    document.StartList("differences");
    report.differences->ForEach([&](const TDifference& difference) { document.AddElement(JsonOfDifference(report, difference)); });
    document.EndList();
    if (report.baseline) {
        document.Add("baseline", JsonOfBaseline(*report.baseline));
    }
    document.Add("coverage", JsonOfCoverage(report));
    document.End();
}

void WriteNdjsonReport(const TComparisonReport& report, const TTextSink& sink)
{
    report.differences->ForEach(
        [&](const TDifference& difference) { sink(WriteJson(JsonOfDifference(report, difference), false)); });
    TJsonDocument line(sink, false);
    line.Add("kind", "coverage");
    AddFindings(line, report);
    if (report.baseline) {
        line.Add("baseline", JsonOfBaseline(*report.baseline));
    }
    const TJson coverage = JsonOfCoverage(report);
    for (const auto& [name, value] : coverage.items()) {
        line.Add(name, value);
    }
    line.End();
}

}  // namespace NORVZEL20

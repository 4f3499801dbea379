// A group of differences of each kind; every name and the order of the names are part of the format:
//
//   { "class": "Package", "kind": "onlyInReference", "inventories": [ "web02" ], "instances": 2,
//     "examples": [ "Package.Name=\"font11\"", "Package.Name=\"libdev5\"" ] }
//   { "class": "Package", "kind": "changed", "property": "Version", "inventories": [ "web02" ], "instances": 43,
//     "distinctChanges": 42,
//     "changes": [ { "instances": 2, "reference": { "type": "string", "value": "1.0" },
//                    "others": [ { "inventories": [ "web02" ], "type": "string", "value": "1.1" } ],
//                    "examples": [ "Package.Name=\"curl\"", "Package.Name=\"libcurl4\"" ] } ] }
//
// "examples" and "changes" hold some of what "instances" and "distinctChanges" count. The differences have all of it, with the same
// texts as "instance". In "others", "sharing" is as it is there; it names an inventory if in any of the differences several of its
// instances have the key.
#include "client/report/JsonGroups.h"

#include <string>
#include <utility>

#include "client/report/JsonDifference.h"
#include "client/report/JsonValue.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

TJson JsonOfPresence(const TComparisonReport& report, const std::string& className, const TPresenceFinding& presence)
{
    TJson examples = TJson::array();
    for (const TPresenceFinding::TExample& example : presence.examples) {
        examples.push_back(example.path);
    }
    return {{"class", className},
            {"kind", JsonOfKind(presence.kind)},
            {"inventories", JsonOfLabels(report, presence.inventories)},
            {"instances", presence.instances},
            {"examples", std::move(examples)}};
}

TJson JsonOfChange(const TComparisonReport& report, const TChangeFinding& finding)
{
    TJson others = TJson::array();
    for (const TValueDifference::TGroup& group : finding.change.others) {
        others.push_back(JsonOfGroup(report, group, finding.sharing));
    }
    return {{"instances", finding.instances},
            {"reference", JsonWithType(finding.change.reference)},
            {"others", std::move(others)},
            {"examples", finding.paths}};
}

TJson JsonOfProperty(const TComparisonReport& report, const std::string& className, const TPropertyFinding& property)
{
    TJson changes = TJson::array();
    for (const TChangeFinding& change : property.examples) {
        changes.push_back(JsonOfChange(report, change));
    }
    return {{"class", className},
            {"kind", JsonOfKind(TDifference::kChanged)},
            {"property", property.property},
            {"inventories", JsonOfLabels(report, property.inventories)},
            {"instances", property.instances},
            {"distinctChanges", property.changes},
            {"changes", std::move(changes)}};
}

}  // namespace

void ForEachGroup(const TComparisonReport& report, const TFindings& findings, const TGroupCallback& callback)
{
    for (const TClassFindings& cls : findings.classes) {
        for (const TPresenceFinding& presence : cls.presences) {
            callback(JsonOfPresence(report, cls.className, presence));
        }
        for (const TPropertyFinding& property : cls.properties) {
            callback(JsonOfProperty(report, cls.className, property));
        }
    }
}

nlohmann::ordered_json JsonOfClassCounts(const TFindings& findings)
{
    TJson classes = TJson::array();
    for (const TClassFindings& cls : findings.classes) {
        classes.push_back({{"class", cls.className},
                           {"onlyInReference", cls.counts.onlyInReference},
                           {"onlyInOthers", cls.counts.onlyInOthers},
                           {"changedValues", cls.counts.changedValues},
                           {"changedInstances", cls.counts.changedInstances}});
    }
    return classes;
}

}  // namespace NORVZEL20

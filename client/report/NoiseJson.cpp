// The document, with one element of each list; every name and the order of the names are part of the format:
//
//   { "format": "cimdelta-noise", "version": 1,
//     "inventories": [ { "label": "boot1", "file": "boot1.xml", "role": "reference" } ],
//     "summary": { "differences": 45, "unexplained": 2, "rules": 4 },
//     "rules": [ { "kind": "property", "option": "--exclude Processor.Load", "class": "Processor", "name": "Load",
//                  "withClassesBelow": true, "instances": 4, "ofInstances": 4, "comparisons": 2, "ofComparisons": 2,
//                  "example": { "property": "Load", "reference": 12, "other": 57, "inventory": "boot2" } } ],
//     "unexplained": [ { "class": "Process", "instances": 13, "onlyInReference": 1, "onlyInOthers": 1, "changedValues": 0 } ],
//     "coverage": { ... } }
//
// The kind is "property", "key" or "class"; a class has no name, and only a property has an example. The coverage is that of a
// comparison without the rules, see JsonFormat.cpp.
#include "client/report/NoiseJson.h"

#include "client/report/JsonCoverage.h"
#include "client/report/JsonValue.h"
#include "client/report/NoiseText.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

const char* NoiseKindName(TNoiseRule::EKind kind)
{
    switch (kind) {
    case TNoiseRule::kProperty:
        return "property";
    case TNoiseRule::kKey:
        return "key";
    default:
        return "class";
    }
}

TJson JsonOfRule(const TNoise& noise, const TNoiseRule& rule)
{
    TJson json = {{"kind", NoiseKindName(rule.kind)}, {"option", NoiseOption(rule)}, {"class", rule.className}};
    if (rule.kind != TNoiseRule::kClass) {
        json["name"] = rule.name;
    }
    json.update({{"withClassesBelow", rule.isForTree},
                 {"instances", rule.affected},
                 {"ofInstances", rule.of},
                 {"comparisons", rule.comparisons},
                 {"ofComparisons", noise.before.labels.size() - 1}});
    if (rule.kind == TNoiseRule::kProperty) {
        const TValueDifference::TGroup& other = rule.example.others.front();
        json["example"] = {{"property", rule.example.property},
                           {"reference", JsonOf(rule.example.reference)},
                           {"other", JsonOf(other.value)},
                           {"inventory", noise.before.labels[other.inventories.front()]}};
    }
    return json;
}

}  // namespace

std::string WriteNoiseJson(const TNoise& noise)
{
    TJson inventories = TJson::array();
    for (std::size_t i = 0; i < noise.before.labels.size(); ++i) {
        inventories.push_back(
            {{"label", noise.before.labels[i]}, {"file", noise.before.paths[i]}, {"role", i == 0 ? "reference" : "other"}});
    }
    TJson rules = TJson::array();
    for (const TNoiseRule& rule : noise.rules) {
        rules.push_back(JsonOfRule(noise, rule));
    }
    TJson unexplained = TJson::array();
    for (const TUnexplained& rest : noise.rest) {
        unexplained.push_back({{"class", rest.className},
                               {"instances", rest.instances},
                               {"onlyInReference", rest.counts.onlyInReference},
                               {"onlyInOthers", rest.counts.onlyInOthers},
                               {"changedValues", rest.counts.changedValues}});
    }
    return WriteJson({{"format", "cimdelta-noise"},
                      {"version", 1},
                      {"inventories", inventories},
                      {"summary",
                       {{"differences", noise.before.differences->GetCounts().GetTotal()},
                        {"unexplained", noise.after.differences->GetCounts().GetTotal()},
                        {"rules", noise.rules.size()}}},
                      {"rules", rules},
                      {"unexplained", unexplained},
                      {"coverage", JsonOfCoverage(noise.before)}},
                     true);
}

}  // namespace NORVZEL20

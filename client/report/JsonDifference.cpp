// One difference of each kind; every name and the order of the names are part of the format:
//
//   { "kind": "changed", "class": "Disk", "instance": "Disk.Id=\"sda\"", "keys": { "Id": "sda" }, "inventories": [ "web02" ],
//     "sharing": [ { "inventory": "web02", "instances": 2 } ],
//     "property": "Size", "reference": { "type": "uint64", "value": 500 },
//     "others": [ { "inventories": [ "web02" ], "type": "uint64", "value": 250,
//                   "sharing": [ { "inventory": "web02", "instances": 1 } ] } ] }
//   { "kind": "onlyInReference", "class": ..., "inventories": [ "web02" ], "path": "root/cimv2:Disk.BootId=1,Id=\"sdb\"",
//     "contents": { "Size": { "type": "uint64", "value": 500 } } }
//   { "kind": "onlyInOthers", "class": ..., "inventories": [ "web02", "web03" ],
//     "disagreements": [ { "property": "Size", "others": [ ... ] } ], "contents": { ... } }
//
// "sharing" is there only if several instances of an inventory have the key: beside "inventories" it says how many, beside a value
// how many of them have the value. A value that is an embedded object has "embedded" with its contents (see ContentsOf), and if all
// values are instances of one class, "parts" behind "others" has the properties in which they differ, each as "property",
// "reference", "others" and perhaps "parts". "path" is there only if the rules of the class exclude keys, "disagreements" only if
// there are any. "contents" has the compared properties that are not null and no keys, of the reference or the first of
// "inventories".
#include "client/report/JsonDifference.h"

#include <algorithm>
#include <utility>

#include "client/report/JsonValue.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

TJson JsonOfSharing(const TComparisonReport& report, std::size_t inventory, std::size_t instances)
{
    return {{"inventory", report.labels[inventory]}, {"instances", instances}};
}

// Makes the parts of one difference, which are all made with its report.
class TDifferenceWriter {
  public:
    TDifferenceWriter(const TComparisonReport& report, const TDifference& difference)
        : fReport(report), fDifference(difference), fSharing(difference.GetSharing())
    {}

    TJson Write() const
    {
        TJson keys = TJson::object();
        for (const auto& key : fDifference.keys) {
            keys[key.first] = JsonOf(key.second);
        }
        TJson json = {{"kind", JsonOfKind(fDifference.kind)},
                      {"class", fDifference.className},
                      {"instance", fDifference.instance},
                      {"keys", keys},
                      {"inventories", JsonOfLabels(fReport, fDifference.inventories)}};
        AddSharing(json);
        if (!fDifference.path.empty()) {
            json["path"] = fDifference.path;
        }
        AddValues(json);
        return json;
    }

  private:
    void AddSharing(TJson& json) const
    {
        TJson sharing = TJson::array();
        for (const std::size_t inventory : fSharing) {
            sharing.push_back(JsonOfSharing(fReport, inventory, fDifference.CountSharing(inventory)));
        }
        AddJsonList(json, "sharing", std::move(sharing));
    }

    void AddValues(TJson& json) const
    {
        if (fDifference.kind == TDifference::kChanged) {
            json.update(Values(fDifference.values.front()));
            return;
        }
        AddJsonList(json, "disagreements", Values(fDifference.values));
        TJson contents = TJson::object();
        for (const auto& [property, value] : fDifference.contents) {
            contents[property] = JsonWithType(value);
        }
        json["contents"] = std::move(contents);
    }

    TJson Values(const std::vector<TValueDifference>& differences) const
    {
        TJson list = TJson::array();
        for (const TValueDifference& values : differences) {
            list.push_back(Values(values));
        }
        return list;
    }

    TJson Values(const TValueDifference& values) const
    {
        TJson json = {{"property", values.property}};
        if (fDifference.kind == TDifference::kChanged) {
            json["reference"] = JsonWithType(values.reference);
        }
        TJson others = TJson::array();
        for (const TValueDifference::TGroup& group : values.others) {
            others.push_back(JsonOfGroup(fReport, group, fSharing));
        }
        AddJsonList(json, "others", std::move(others));
        AddJsonList(json, "parts", Values(values.parts));
        return json;
    }

    const TComparisonReport& fReport;
    const TDifference& fDifference;
    const std::vector<std::size_t> fSharing;
};

}  // namespace

const char* JsonOfKind(TDifference::EKind kind)
{
    switch (kind) {
    case TDifference::kOnlyInReference:
        return "onlyInReference";
    case TDifference::kOnlyInOthers:
        return "onlyInOthers";
    default:
        return "changed";
    }
}

nlohmann::ordered_json JsonOfLabels(const TComparisonReport& report, const std::vector<std::size_t>& inventories)
{
    TJson labels = TJson::array();
    for (const std::size_t inventory : inventories) {
        labels.push_back(report.labels[inventory]);
    }
    return labels;
}

nlohmann::ordered_json JsonOfGroup(const TComparisonReport& report, const TValueDifference::TGroup& group,
                                   const std::vector<std::size_t>& sharing)
{
    TJson json = {{"inventories", JsonOfLabels(report, group.inventories)}};
    json.update(JsonWithType(group.value));
    TJson counts = TJson::array();
    for (std::size_t i = 0; i < group.inventories.size(); ++i) {
        if (std::binary_search(sharing.begin(), sharing.end(), group.inventories[i])) {
            counts.push_back(JsonOfSharing(report, group.inventories[i], group.CountInstances(i)));
        }
    }
    AddJsonList(json, "sharing", std::move(counts));
    return json;
}

nlohmann::ordered_json JsonOfDifference(const TComparisonReport& report, const TDifference& difference)
{
    return TDifferenceWriter(report, difference).Write();
}

}  // namespace NORVZEL20

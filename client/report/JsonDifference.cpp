// One difference of each kind; every name and the order of the names are part of the format:
//
//   { "kind": "changed", "class": "Disk", "instance": "Disk.Id=\"sda\"", "keys": { "Id": "sda" }, "inventories": [ "web02" ],
//     "sharing": [ { "inventory": "web02", "instances": 2 } ],
//     "property": "Size", "reference": { "type": "uint64", "value": 500 },
//     "others": [ { "inventories": [ "web02" ], "type": "uint64", "value": 250,
//                   "sharing": [ { "inventory": "web02", "instances": 1 } ] } ] }
//   { "kind": "onlyInReference", "class": ..., "inventories": [ "web02" ], "path": "root/cimv2:Disk.BootId=1,Id=\"sdb\"" }
//   { "kind": "onlyInOthers", "class": ..., "inventories": [ "web02", "web03" ],
//     "disagreements": [ { "property": "Size", "others": [ ... ] } ] }
//
// "sharing" is there only if several instances of an inventory have the key: beside "inventories" it says how many, beside a value
// how many of them have the value. A value that is an embedded object has "embedded" with its contents (see ContentsOf), and if all
// values are instances of one class, "parts" behind "others" has the properties in which they differ, each as "property",
// "reference", "others" and perhaps "parts". "path" is there only if the rules exclude keys, "disagreements" only if there are any.
#include "client/report/JsonDifference.h"

#include "client/report/JsonValue.h"
#include "client/text/EmbeddedText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

const char* KindName(TDifference::EKind kind)
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

TJson ValueWithType(const TCIMValue& value)
{
    TJson json = {{"type", TValueText::DescribeType(value.GetType())}, {"value", JsonOf(value)}};
    if (HasEmbeddedObject(value)) {
        json["embedded"] = ContentsOf(value);
    }
    return json;
}

// Makes the parts of one difference, which are all made with its report.
class TDifferenceWriter {
  public:
    TDifferenceWriter(const TComparisonReport& report, const TDifference& difference) : fReport(report), fDifference(difference) {}

    TJson Write() const
    {
        TJson keys = TJson::object();
        for (const auto& key : fDifference.keys) {
            keys[key.first] = JsonOf(key.second);
        }
        TJson json = {{"kind", KindName(fDifference.kind)},
                      {"class", fDifference.className},
                      {"instance", fDifference.instance},
                      {"keys", keys},
                      {"inventories", Labels(fDifference.inventories)}};
        AddSharing(json);
        if (!fDifference.path.empty()) {
            json["path"] = fDifference.path;
        }
        AddValues(json);
        return json;
    }

  private:
    TJson Labels(const std::vector<std::size_t>& inventories) const
    {
        TJson labels = TJson::array();
        for (const std::size_t inventory : inventories) {
            labels.push_back(fReport.labels[inventory]);
        }
        return labels;
    }

    TJson Sharing(std::size_t inventory, std::size_t instances) const
    {
        return {{"inventory", fReport.labels[inventory]}, {"instances", instances}};
    }

    void AddSharing(TJson& json) const
    {
        for (std::size_t i = 0; i < fDifference.sharing.size(); ++i) {
            if (fDifference.CountSharing(i) > 0) {
                json["sharing"].push_back(Sharing(i, fDifference.CountSharing(i)));
            }
        }
    }

    void AddValues(TJson& json) const
    {
        if (fDifference.kind == TDifference::kChanged) {
            json.update(Values(fDifference.values.front()));
            return;
        }
        for (const TValueDifference& values : fDifference.values) {
            json["disagreements"].push_back(Values(values));
        }
    }

    TJson Values(const TValueDifference& values) const
    {
        TJson json = {{"property", values.property}};
        if (fDifference.kind == TDifference::kChanged) {
            json["reference"] = ValueWithType(values.reference);
        }
        for (const TValueDifference::TGroup& group : values.others) {
            json["others"].push_back(Group(group));
        }
        for (const TValueDifference& part : values.parts) {
            json["parts"].push_back(Values(part));
        }
        return json;
    }

    TJson Group(const TValueDifference::TGroup& group) const
    {
        TJson json = {{"inventories", Labels(group.inventories)}};
        json.update(ValueWithType(group.value));
        for (std::size_t i = 0; i < group.inventories.size(); ++i) {
            if (fDifference.CountSharing(group.inventories[i]) > 0) {
                json["sharing"].push_back(Sharing(group.inventories[i], group.instances[i]));
            }
        }
        return json;
    }

    const TComparisonReport& fReport;
    const TDifference& fDifference;
};

}  // namespace

nlohmann::ordered_json JsonOfDifference(const TComparisonReport& report, const TDifference& difference)
{
    return TDifferenceWriter(report, difference).Write();
}

}  // namespace NORVZEL20

// The object; every name and the order of the names are part of the format:
//
//   { "file": "base.txt", "accepting": false, "accepted": 37, "new": 1, "changedSince": 1,
//     "changed": [ { "kind": "changed", "instance": "Disk.Id=\"sda\"", "inventories": [ "web02" ],
//                    "values": [ { "property": "Size", "reference": "uint64 500", "other": "uint64 300" } ], "acceptedBecause": "",
//                    "accepted": [ { "property": "Size", "reference": "uint64 500", "other": "uint64 250" } ] } ],
//     "gone": [ { "kind": ..., "instance": ..., "inventories": [ ... ], "values": [ ... ], "acceptedBecause": "June" } ],
//     "notCompared": [ ... ], "otherInventories": [ "web09" ], "entriesOfOtherInventories": 2, "entriesOfReference": 0 }
//
// Values are texts as in the file. "reference" is null except for "changed". "acceptedBecause" is the reason in the file.
#include "client/report/JsonBaseline.h"

#include "client/report/JsonDifference.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

TJson JsonOfValues(const std::vector<TAcceptedDifference::TValue>& values)
{
    TJson list = TJson::array();
    for (const TAcceptedDifference::TValue& value : values) {
        const TJson before = value.before.empty() ? TJson(nullptr) : TJson(value.before);
        list.push_back({{"property", value.property}, {"reference", before}, {"other", value.after}});
    }
    return list;
}

TJson JsonOfEntry(const TAcceptedDifference& entry)
{
    return {{"kind", JsonOfKind(entry.kind)},
            {"instance", entry.instance},
            {"inventories", entry.inventories},
            {"values", JsonOfValues(entry.values)},
            {"acceptedBecause", entry.reason}};
}

TJson JsonOfEntries(const std::vector<TAcceptedDifference>& entries)
{
    TJson list = TJson::array();
    for (const TAcceptedDifference& entry : entries) {
        list.push_back(JsonOfEntry(entry));
    }
    return list;
}

}  // namespace

nlohmann::ordered_json JsonOfBaseline(const TBaselineOutcome& outcome)
{
    TJson changed = TJson::array();
    for (const TBaselineOutcome::TChanged& pair : outcome.changed) {
        TJson json = JsonOfEntry(pair.present);
        json["acceptedBecause"] = pair.accepted.reason;
        json["accepted"] = JsonOfValues(pair.accepted.values);
        changed.push_back(std::move(json));
    }
    return {{"file", outcome.file},
            {"accepting", outcome.isAccepting},
            {"accepted", outcome.accepted},
            {"new", outcome.appeared},
            {"changedSince", outcome.changed.size()},
            {"changed", std::move(changed)},
            {"gone", JsonOfEntries(outcome.gone)},
            {"notCompared", JsonOfEntries(outcome.notCompared)},
            {"otherInventories", outcome.absent},
            {"entriesOfOtherInventories", outcome.ofAbsent},
            {"entriesOfReference", outcome.ofReference}};
}

}  // namespace NORVZEL20

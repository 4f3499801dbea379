// From records to differences.
//
// A record names a class, an instance, a property and the positions of inventories, but no value. The values are looked up:
//   instance removed    the keys of the reference's instance
//   instance added      the keys of the instance in the first inventory that has it
//   property changed    the reference's value, and the value of each inventory concerned; inventories with equal values are grouped
//
// After a run with two inventories the reference holds the other one's values. The embedded host keeps what a property held before
// its first change; a report shows this earlier value.
//
// Records come class by class. An index from key to instances is made for one class and inventory when it is first needed.
#include "client/comparison/TDifferenceReader.h"

#include <algorithm>
#include <tuple>

#include "client/comparison/ReadDeltaRecords.h"
#include "client/inventory/CollectObjects.h"
#include "embedded/store/TInMemProperty.h"
#include "embedded/store/TInMemStaticProperty.h"

namespace NORVZEL20 {

namespace {

// What the embedded host kept of a property that was changed; null if it was not changed.
const TCIMValue* FindEarlier(const ICIMProperty& property)
{
    if (const auto* const stored = dynamic_cast<const TInMemProperty*>(&property)) {
        return stored->GetEarlierValue();
    }
    const auto* const shared = dynamic_cast<const TInMemStaticProperty*>(&property);
    return shared == nullptr ? nullptr : shared->GetEarlierValue();
}

// The value before the run, and before PutReferenceStandIns.
TCIMValue ValueBefore(const ICIMInstance& instance, const std::string& property)
{
    const boost::shared_ptr<ICIMProperty> handle = instance.GetProperty(property, TCallContext());
    const TCIMValue* const earlier = FindEarlier(*handle);
    return earlier == nullptr ? handle->GetValue(TCallContext()) : *earlier;
}

// Equal and written alike: datetimes with different offsets from UTC can be equal, but a report shows their texts.
bool LookEqual(const TCIMValue& a, const TCIMValue& b)
{
    return a == b && a.ToText() == b.ToText();
}

void AddToGroups(std::vector<TDifference::TGroup>& groups, std::size_t inventory, const TCIMValue& value)
{
    for (TDifference::TGroup& group : groups) {
        if (LookEqual(group.value, value)) {
            // Instances that share a key may bring the same value twice.
            if (group.inventories.back() != inventory) {
                group.inventories.push_back(inventory);
            }
            return;
        }
    }
    groups.push_back({{inventory}, value});
}

bool StandsBefore(const TDifference& a, const TDifference& b)
{
    return std::tie(a.className, a.instance, a.kind, a.property) < std::tie(b.className, b.instance, b.kind, b.property);
}

}  // namespace

std::vector<TDifference> TDifferenceReader::Read(TDeltaNamespace& records)
{
    std::vector<TDifference> differences;
    for (const auto& ofClass : ReadDeltaRecords(records)) {
        StartClass(ofClass.first);
        for (const TDeltaRecord& record : ofClass.second) {
            differences.push_back(Make(record));
        }
    }
    std::sort(differences.begin(), differences.end(), StandsBefore);
    return differences;
}

void TDifferenceReader::StartClass(const std::string& className)
{
    fClassName = className;
    fIndexes.clear();
    fIndexes.resize(fInventories.size());
    fByPath.clear();
}

TDifference TDifferenceReader::Make(const TDeltaRecord& record)
{
    TDifference difference;
    difference.className = fClassName;
    difference.instance = record.instanceName;
    difference.property = record.property;
    difference.inventories = record.inventories;
    boost::shared_ptr<ICIMInstance> instance;
    switch (record.type) {
    case TDeltaNamespace::kInstanceRemoved:
        difference.kind = TDifference::kOnlyInReference;
        instance = FindByPath(record.instanceName);
        difference.instance = fRules.KeyOf(fClassName, instance);
        break;
    case TDeltaNamespace::kInstanceAdded:
        difference.kind = TDifference::kOnlyInOthers;
        instance = Index(difference.inventories.front()).Find(record.instanceName).at(0);
        break;
    case TDeltaNamespace::kPropertyChanged:
        difference.kind = TDifference::kChanged;
        instance = Index(0).Find(record.instanceName).at(0);
        difference.reference = ValueBefore(*instance, record.property);
        AddValues(difference);
        break;
    }
    AddKeys(difference, *instance);
    return difference;
}

// The reference's instance that a record of a removed instance names: by its key, or by its own path if the class excludes keys.
boost::shared_ptr<ICIMInstance> TDifferenceReader::FindByPath(const std::string& path)
{
    if (fRules.ExcludedKeysOf(fClassName).empty()) {
        return Index(0).Find(path).at(0);
    }
    if (fByPath.empty()) {
        for (const boost::shared_ptr<ICIMInstance>& instance :
             InstancesOf(*fInventories[0].ns->GetClass(fClassName, TCallContext()))) {
            fByPath[instance->GetReference(TCallContext()).GetPath()] = instance;
        }
    }
    return fByPath.at(path);
}

const TInstanceIndex& TDifferenceReader::Index(std::size_t inventory)
{
    std::unique_ptr<TInstanceIndex>& index = fIndexes.at(inventory);
    if (!index) {
        index = std::make_unique<TInstanceIndex>(*fInventories[inventory].ns, fClassName, fRules);
    }
    return *index;
}

// The keys are those of the instance's own class: with --strict-schema, another inventory may declare others than the reference.
void TDifferenceReader::AddKeys(TDifference& difference, const ICIMInstance& instance) const
{
    const std::vector<std::string>& excluded = fRules.ExcludedKeysOf(fClassName);
    for (const std::string& name : KeyNamesOf(*instance.GetClass(TCallContext()))) {
        if (std::find(excluded.begin(), excluded.end(), name) == excluded.end()) {
            difference.keys.push_back({name, ValueBefore(instance, name)});
        }
    }
}

void TDifferenceReader::AddValues(TDifference& difference)
{
    for (const std::size_t inventory : difference.inventories) {
        for (const TCIMValue& value : OtherValues(difference, inventory)) {
            AddToGroups(difference.others, inventory, value);
        }
    }
}

// The inventory's value. If keys are excluded, several instances may share the key: then all values that are not the reference's.
std::vector<TCIMValue> TDifferenceReader::OtherValues(const TDifference& difference, std::size_t inventory)
{
    std::vector<TCIMValue> values;
    for (const boost::shared_ptr<ICIMInstance>& instance : Index(inventory).Find(difference.instance)) {
        values.push_back(ValueBefore(*instance, difference.property));
    }
    if (values.size() > 1) {
        values.erase(std::remove_if(values.begin(), values.end(),
                                    [&](const TCIMValue& value) { return LookEqual(value, difference.reference); }),
                     values.end());
    }
    return values;
}

}  // namespace NORVZEL20

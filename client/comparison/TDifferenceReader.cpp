// From records to differences.
//
// A record names a class, an instance, a property and the positions of inventories, but no value. The values are looked up:
//   instance removed    the keys of the reference's instance
//   instance added      the keys of the instance in the first inventory that has it, and the properties in which the instances
//                       that have the key differ from one another: the plug-in does not compare these
//   property changed    the reference's value, and the value of each inventory concerned
//
// Inventories with equal values are grouped. Whether values are equal is asked of the plug-in. It lets the declaration of the
// reference decide whether the order of an array counts, so each value is asked about in the form that the reference would hold.
//
// After a run with two inventories the reference holds the other one's values. The embedded host keeps what a property held before
// its first change; a report shows this earlier value.
//
// Records come class by class. An index from key to instances is made for one class and inventory when it is first needed.
#include "client/comparison/TDifferenceReader.h"

#include <algorithm>
#include <utility>

#include "client/comparison/EmbeddedParts.h"
#include "client/comparison/ReadDeltaRecords.h"
#include "client/inventory/CollectObjects.h"
#include "client/inventory/FindDeclarations.h"
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

// The instance's value, or a null of the type `declared` if its class lacks the property. That is possible with --strict-schema
// only.
TCIMValue ValueIfDeclared(const ICIMInstance& instance, const std::string& property, TCIMValue::TCIMType declared)
{
    const boost::shared_ptr<ICIMClass> cls = instance.GetClass(TCallContext());
    return FindPropertyDecl(*cls, property) ? ValueBefore(instance, property) : TCIMValue::Null(declared);
}

// The array as a property declared like this would hold it: it is a bag if the declaration makes it one, else it is not.
TCIMValue InFormOf(const TInMemPropertyDecl& declared, const TCIMValue& value)
{
    if (declared.IsBag()) {
        return value.AsBag();
    }
    return value.IsBag() ? TCIMValue(value.GetType(), static_cast<unsigned>(value.GetElements().size()), value.GetElements())
                         : value;
}

std::vector<std::string> WithoutKeys(std::vector<std::string> properties, const TInMemClass& cls)
{
    const std::vector<std::string> keys = KeyNamesOf(cls);
    properties.erase(
        std::remove_if(properties.begin(), properties.end(),
                       [&keys](const std::string& name) { return std::find(keys.begin(), keys.end(), name) != keys.end(); }),
        properties.end());
    return properties;
}

}  // namespace

void TDifferenceReader::StartClass(const std::string& className)
{
    if (fClass && className == fClassName) {
        return;
    }
    fClassName = className;
    fIndexes.clear();
    fIndexes.resize(fInventories.size());
    fByPath.reset();
    fClass = fInventories[0].ns->FindClass(className);
    fProperties = fRules.PropertiesOf(fClass);
    fContents = WithoutKeys(fProperties, *fClass);
    std::sort(fProperties.begin(), fProperties.end());
    fExcludesKeys = !fRules.ExcludedKeysOf(className).empty();
    fHasKeys = !KeyNamesOf(*fClass).empty();
    fKeysOf.reset();
}

TDifference TDifferenceReader::Read(const ICIMInstance& delta)
{
    TDeltaRecord record = ReadDeltaRecord(delta);
    TDifference difference;
    difference.className = fClassName;
    difference.instance = std::move(record.instanceName);
    difference.inventories = std::move(record.inventories);
    difference.hasKeys = fHasKeys;
    boost::shared_ptr<ICIMInstance> instance;
    switch (record.type) {
    case TDeltaNamespace::kInstanceRemoved:
        difference.kind = TDifference::kOnlyInReference;
        instance = FindByPath(difference.instance);
        difference.path = fExcludesKeys ? std::move(difference.instance) : std::string();
        difference.instance = fRules.KeyOf(fClassName, instance);
        AddContents(difference, *instance);
        break;
    case TDeltaNamespace::kInstanceAdded:
        difference.kind = TDifference::kOnlyInOthers;
        instance = Index(difference.inventories.front()).Find(difference.instance).at(0);
        AddContents(difference, *instance);
        AddDisagreements(difference);
        break;
    case TDeltaNamespace::kPropertyChanged:
        difference.kind = TDifference::kChanged;
        instance = Index(0).Find(difference.instance).at(0);
        AddChange(difference, record.property, *instance);
        break;
    }
    AddKeys(difference, *instance);
    CountSharing(difference);
    return difference;
}

// The reference's instance that a record of a removed instance names: by its key, or by its own path if the class excludes keys.
boost::shared_ptr<ICIMInstance> TDifferenceReader::FindByPath(const std::string& path)
{
    if (!fExcludesKeys) {
        return Index(0).Find(path).at(0);
    }
    if (!fByPath) {
        fByPath = std::make_unique<TInstanceIndex>(fClass, [](const boost::shared_ptr<ICIMInstance>& instance) {
            return instance->GetReference(TCallContext()).GetPath();
        });
    }
    return fByPath->Find(path).at(0);
}

TCIMValue TDifferenceReader::KeyOf(const ICIMInstance& record)
{
    const TCIMValue name = InstanceOfRecord(record);
    return fExcludesKeys && TypeOfRecord(record) == TDeltaNamespace::kInstanceRemoved
               ? TCIMValue(fRules.KeyOf(fClassName, FindByPath(std::string(name.GetString()))))
               : name;
}

std::size_t TDifferenceReader::CountInstances(const ICIMInstance& record)
{
    if (!fExcludesKeys) {
        return 1;
    }
    const TDeltaRecord added = ReadDeltaRecord(record);
    std::size_t most = 1;
    for (const std::size_t inventory : added.inventories) {
        most = std::max(most, Index(inventory).Find(added.instanceName).size());
    }
    return most;
}

TInstanceIndex& TDifferenceReader::Index(std::size_t inventory)
{
    std::unique_ptr<TInstanceIndex>& index = fIndexes.at(inventory);
    if (!index) {
        index = std::make_unique<TInstanceIndex>(*fInventories[inventory].ns, fClassName, fRules);
    }
    return *index;
}

// The keys are those of the instance's own class: with --strict-schema, another inventory may declare others than the reference.
void TDifferenceReader::AddKeys(TDifference& difference, const ICIMInstance& instance)
{
    const boost::shared_ptr<ICIMClass> cls = instance.GetClass(TCallContext());
    if (cls != fKeysOf) {
        fKeysOf = cls;
        fKeys = KeyNamesOf(*cls);
        fKeys.erase(std::remove_if(fKeys.begin(), fKeys.end(),
                                   [this](const std::string& name) { return fRules.ExcludesKey(fClassName, name); }),
                    fKeys.end());
    }
    difference.keys.reserve(fKeys.size());
    for (const std::string& name : fKeys) {
        difference.keys.push_back({name, ValueBefore(instance, name)});
    }
}

void TDifferenceReader::AddContents(TDifference& difference, const ICIMInstance& instance) const
{
    for (const std::string& property : fContents) {
        TCIMValue value = ValueIfDeclared(instance, property, TCIMValue::TCIMType::kNone);
        if (!value.IsNull()) {
            difference.contents.emplace_back(property, std::move(value));
        }
    }
}

// If instances of an inventory share the key, only some of them may differ from the reference.
void TDifferenceReader::AddChange(TDifference& difference, const std::string& property, const ICIMInstance& reference)
{
    difference.values.resize(1);
    TValueDifference& change = difference.values.front();
    change.property = property;
    change.reference = ValueBefore(reference, change.property);
    TValueGroups groups = MakeGroups(change);
    for (const std::size_t inventory : difference.inventories) {
        const TInstanceIndex::TInstances& instances = Index(inventory).Find(difference.instance);
        for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
            const TCIMValue value = ValueBefore(*instance, change.property);
            if (instances.size() == 1 || fRules.Differ(fClassName, change.reference, value)) {
                groups.Get(value).Add(inventory, 1);
            }
        }
    }
    AddEmbeddedParts(change, true);
}

void TDifferenceReader::AddDisagreements(TDifference& difference)
{
    std::vector<std::pair<std::size_t, boost::shared_ptr<ICIMInstance>>> instances;
    for (const std::size_t inventory : difference.inventories) {
        for (const boost::shared_ptr<ICIMInstance>& instance : Index(inventory).Find(difference.instance)) {
            instances.push_back({inventory, instance});
        }
    }
    for (std::size_t i = 0; instances.size() > 1 && i < fProperties.size(); ++i) {
        TValueDifference values;
        values.property = fProperties[i];
        const TCIMValue::TCIMType declared = fClass->FindPropertyDecl(values.property)->GetType();
        TValueGroups groups = MakeGroups(values);
        for (const auto& [inventory, instance] : instances) {
            groups.Get(ValueIfDeclared(*instance, values.property, declared)).Add(inventory, 1);
        }
        if (groups.Differ()) {
            AddEmbeddedParts(values, false);
            difference.values.push_back(std::move(values));
        }
    }
}

// The difference must outlive the result.
TValueGroups TDifferenceReader::MakeGroups(TValueDifference& difference) const
{
    const auto areEqual = [this, &property = difference.property](const TCIMValue& one, const TCIMValue& other) {
        return one.GetType().IsArray() && !one.IsNull()
                   ? !fRules.Differ(fClassName, InFormOf(*fClass->FindPropertyDecl(property), one), other)
                   : !fRules.Differ(fClassName, one, other);
    };
    return TValueGroups(difference, areEqual, [this](const TCIMValue& value) { return fRules.HashOf(fClassName, value); });
}

// The reference lacks the instance of an added key. After a run with two inventories it has a copy, which does not count.
void TDifferenceReader::CountSharing(TDifference& difference)
{
    if (!fExcludesKeys) {
        return;
    }
    difference.sharing.assign(fInventories.size(), 0);
    for (std::size_t i = difference.kind == TDifference::kOnlyInOthers ? 1 : 0; i < fInventories.size(); ++i) {
        difference.sharing[i] = Index(i).Find(difference.instance).size();
    }
}

}  // namespace NORVZEL20

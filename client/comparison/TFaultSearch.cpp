// Where a run failed.
//
// The exception of a run has a status and no place. But a run goes its way in a fixed order, and what it has done until the failure
// can be seen: the records are written, and the reference has taken over values and instances. So the same steps are taken again
// over what the run has left, and the first one that cannot be done is the one that failed:
//
//   adding       with two inventories, an instance that only the other one has is recorded and then added to the reference. If that
//                failed, the last record is the instance's.
//   comparing    a pair of instances cannot be compared if a property is missing in the other inventory, if the engine refuses
//                its values, or if the reference (with two inventories) cannot take over a value of another type.
//   matching     an instance cannot be matched if the plug-in cannot make its key.
#include "client/comparison/TFaultSearch.h"

#include <boost/algorithm/string/join.hpp>
#include <memory>

#include "client/comparison/ReadDeltaRecords.h"
#include "client/comparison/TInstanceIndex.h"
#include "client/inventory/CollectObjects.h"
#include "client/inventory/PropertyValue.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

std::string Named(const std::string& property, const TInMemClass& cls)
{
    return "property " + property + " of class " + cls.GetName();
}

std::string DescribeTypes(const TInMemClass& cls, const TInMemPropertyDecl& property, const TInventory& reference,
                          const TInMemPropertyDecl& counterpart, const TInventory& other)
{
    return Named(property.GetName(), cls) + " is " + TValueText::DescribeType(property.GetType()) + " in " + reference.path +
           " and " + TValueText::DescribeType(counterpart.GetType()) + " in " + other.path;
}

std::string KeysOf(const TInMemClass& cls)
{
    return boost::algorithm::join(KeyNamesOf(cls), ", ");
}

}  // namespace

TFaultSearch::TCause TFaultSearch::FindRefusedInstance(TDeltaNamespace& records, TZELStatusCode status) const
{
    std::string className;
    TDeltaRecord last{};
    if (fInventories.size() != 2 || !ReadLastDeltaRecord(records, className, last) ||
        last.type != TDeltaNamespace::kInstanceAdded) {
        return {};
    }
    TInstanceIndex index(*fInventories[1].ns, className, fRules);
    const boost::shared_ptr<ICIMInstance> instance = index.Find(last.instanceName).at(0);
    const auto& added = static_cast<const TInMemInstance&>(*instance);  // the client's inventories are in memory
    const boost::shared_ptr<TInMemClass> cls = fInventories[0].ns->FindClass(className);
    const TCause cause = CheckProperties(*cls, added, last.instanceName);
    // The other statuses may also be those of a later class, if the instance was added.
    const bool isAddingRefused = status == TZELStatusCode::kAlreadyExists || status == TZELStatusCode::kKeyMissing;
    return cause.text.empty() && isAddingRefused ? CheckNewKeys(*cls, added, last.instanceName) : cause;
}

TFaultSearch::TCause TFaultSearch::CheckProperties(const TInMemClass& cls, const TInMemInstance& added,
                                                   const std::string& key) const
{
    const TInMemLayout& layout = added.GetInMemClass()->GetLayout();
    for (const std::uint32_t slot : layout.GetOrder()) {
        const TInMemPropertyDecl& property = layout.GetDecl(slot);
        const boost::shared_ptr<TInMemPropertyDecl> counterpart = cls.FindPropertyDecl(property.GetName());
        if (added.GetSlotValue(slot).IsNull()) {
            continue;
        }
        if (!counterpart) {
            return {fInventories[0].path + " does not declare " + Named(property.GetName(), cls) + ", which instance " + key +
                        " of " + fInventories[1].path + " has",
                    kCompleted};
        }
        if (counterpart->GetType() != property.GetType()) {
            return {DescribeTypes(cls, *counterpart, fInventories[0], property, fInventories[1]),
                    "instances of both types are compared"};
        }
    }
    return {};
}

TFaultSearch::TCause TFaultSearch::CheckNewKeys(const TInMemClass& cls, const TInMemInstance& added, const std::string& key) const
{
    const TInMemClass& there = *added.GetInMemClass();
    const std::string refused = "instance " + key + " of " + fInventories[1].path + " cannot be added to " + fInventories[0].path;
    const std::string spelled = "names get the spelling of " + fInventories[0].path;
    if (KeysOf(cls) != KeysOf(there)) {
        return {refused + ": the keys of class " + cls.GetName() + " are " + KeysOf(cls) + " in " + fInventories[0].path + " and " +
                    KeysOf(there) + " in " + fInventories[1].path,
                TNameText::Equal(KeysOf(cls), KeysOf(there)) ? spelled : "the instances are reported as different ones"};
    }
    if (cls.GetName() != there.GetName()) {
        return {refused + ": class " + cls.GetName() + " is spelled " + there.GetName() + " in " + fInventories[1].path, spelled};
    }
    return {refused + ", which has one with the same keys", ""};
}

TFaultSearch::TCause TFaultSearch::FindRefusedPair() const
{
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*fInventories[0].ns)) {
        const std::vector<std::string> properties = fRules.PropertiesOf(cls);
        if (properties.empty()) {
            continue;
        }
        TCause cause = CheckClass(*fInventories[0].ns->FindClass(cls->GetName(TCallContext())), properties);
        if (!cause.text.empty()) {
            return cause;
        }
    }
    return {};
}

TFaultSearch::TCause TFaultSearch::CheckClass(TInMemClass& cls, const std::vector<std::string>& properties) const
{
    TCause cause = CheckKeys(fInventories[0], cls.GetName());
    std::unique_ptr<TInstanceIndex> masters;
    for (std::size_t i = 1; i < fInventories.size() && cause.text.empty(); ++i) {
        const boost::shared_ptr<TInMemClass> there = fInventories[i].ns->FindClass(cls.GetName());
        if (!there) {
            continue;
        }
        cause = CheckKeys(fInventories[i], cls.GetName());
        if (!masters && cause.text.empty()) {
            masters = std::make_unique<TInstanceIndex>(*fInventories[0].ns, cls.GetName(), fRules);
        }
        for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(*there)) {
            if (!cause.text.empty()) {
                return cause;
            }
            const TInstanceIndex::TInstances& found = masters->Find(fRules.KeyOf(cls.GetName(), instance));
            if (!found.empty()) {
                cause = CheckPair(*found.front(), static_cast<const TInMemInstance&>(*instance), fInventories[i], properties);
            }
        }
    }
    return cause;
}

TFaultSearch::TCause TFaultSearch::CheckKeys(const TInventory& inventory, const std::string& className) const
{
    const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
    for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(*cls)) {
        try {
            fRules.KeyOf(className, instance);
        } catch (const TZELException& error) {
            return {"the keys " + KeysOf(*cls) + " of an instance of class " + className + " of " + inventory.path +
                        " cannot be written as a path: " + error.what(),
                    ""};
        }
    }
    return {};
}

// The engine refuses some pairs of values. A reference that takes over the other's value refuses one of another type.
bool TFaultSearch::IsRefused(const TInMemClass& cls, const TCIMValue& master, const TCIMValue& other,
                             const TInMemPropertyDecl& declared) const
{
    const bool isTakenOver = fInventories.size() == 2 && !other.IsNull();
    return fRules.Refuse(cls.GetName(), master, other) || (isTakenOver && other.GetType() != declared.GetType());
}

TFaultSearch::TCause TFaultSearch::CheckPair(const ICIMInstance& master, const TInMemInstance& instance,
                                             const TInventory& inventory, const std::vector<std::string>& properties) const
{
    const TInMemClass& cls = *static_cast<const TInMemInstance&>(master).GetInMemClass();
    for (const std::string& name : properties) {
        const boost::shared_ptr<TInMemPropertyDecl> declared = cls.FindPropertyDecl(name);
        const boost::shared_ptr<TInMemPropertyDecl> there = instance.GetInMemClass()->FindPropertyDecl(name);
        if (!there) {
            return {inventory.path + " does not declare " + Named(name, cls), kCompleted};
        }
        if (IsRefused(cls, ValueOf(master, name), ValueOf(instance, name), *declared)) {
            return {DescribeTypes(cls, *declared, fInventories[0], *there, inventory), "the values are reported as different"};
        }
    }
    return {};
}

}  // namespace NORVZEL20

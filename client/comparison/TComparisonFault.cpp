// The plug-in ends a run with a status and a few words that name neither file nor class. The status narrows down what can be wrong
// with the inventories, so this looks for the first thing of that kind, in the order in which the plug-in walks the classes:
//
//   kInitializationFailed (3)    an operating system that is missing or has no usable OSType
//   kTypeMismatch (13)           a property that has another type in another inventory
//   kNotFound (15)               a property that another inventory does not declare
//   kSchemaMismatch (37)         a class that another inventory does not declare
#include "client/comparison/TComparisonFault.h"

#include "client/inventory/CollectObjects.h"
#include "client/inventory/PropertyValue.h"
#include "embedded/value/TValueText.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

std::string Name(const ICIMClass& cls)
{
    return cls.GetName(TCallContext());
}

// Whether the plug-in can read the OSType of the first instance: it must convert to uint16.
bool HasUsableType(TInMemClass& systems)
{
    try {
        const unsigned short type = ValueOf(*InstancesOf(systems).at(0), kOperatingSystemType);
        static_cast<void>(type);
        return true;
    } catch (const TZELException&) {
        return false;
    }
}

// The cause of kInitializationFailed (3): the first inventory that lacks what the plug-in requires of it.
std::string FindSystemTrouble(const std::vector<TInventory>& inventories)
{
    for (const TInventory& inventory : inventories) {
        if (!inventory.ns->FindClass(kOperatingSystemClass)) {
            return inventory.path + " declares no class " + kOperatingSystemClass;
        }
    }
    const boost::shared_ptr<TInMemClass> systems = inventories[0].ns->FindClass(kOperatingSystemClass);
    if (systems->GetInstanceCount() == 0) {
        return inventories[0].path + " has no instance of " + kOperatingSystemClass;
    }
    if (HasUsableType(*systems)) {
        return "the inventories are as they should be; perhaps there was not enough memory";
    }
    return "the first " + std::string(kOperatingSystemClass) + " of " + inventories[0].path + " has no " + kOperatingSystemType +
           " between 0 and 65535";
}

// The cause of kSchemaMismatch (37).
std::string FindUndeclaredClass(const TInventory& reference, const TInventory& other, TInMemClass& cls,
                                const std::vector<std::string>&)
{
    return cls.GetInstanceCount() > 0 && !other.ns->FindClass(cls.GetName())
               ? other.path + " does not declare class " + cls.GetName() + ", of which " + reference.path + " has instances"
               : std::string();
}

// The cause of kNotFound (15).
std::string FindUndeclaredProperty(const TInventory&, const TInventory& other, TInMemClass& cls,
                                   const std::vector<std::string>& properties)
{
    const boost::shared_ptr<TInMemClass> there = other.ns->FindClass(cls.GetName());
    for (const std::string& property : properties) {
        if (there && there->GetInstanceCount() > 0 && !there->FindPropertyDecl(property)) {
            return other.path + " does not declare property " + property + " of class " + cls.GetName();
        }
    }
    return std::string();
}

// The cause of kTypeMismatch (13).
std::string FindOtherType(const TInventory& reference, const TInventory& other, TInMemClass& cls, const std::vector<std::string>&)
{
    const boost::shared_ptr<TInMemClass> there = other.ns->FindClass(cls.GetName());
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        const TInMemPropertyDecl& property = cls.GetLayout().GetDecl(slot);
        const boost::shared_ptr<TInMemPropertyDecl> counterpart = there ? there->FindPropertyDecl(property.GetName()) : nullptr;
        if (counterpart && counterpart->GetType() != property.GetType()) {
            return "property " + property.GetName() + " of class " + cls.GetName() + " is " +
                   TValueText::DescribeType(property.GetType()) + " in " + reference.path + " and " +
                   TValueText::DescribeType(counterpart->GetType()) + " in " + other.path;
        }
    }
    return std::string();
}

// The first text that `find` gives for a class that is compared; empty if it gives none.
template <class TFind>
std::string FindFirst(const std::vector<TInventory>& inventories, TRules& rules, TFind find)
{
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*inventories[0].ns)) {
        const std::vector<std::string> properties = rules.PropertiesOf(cls);
        for (std::size_t i = 1; i < inventories.size() && !properties.empty(); ++i) {
            const std::string trouble = find(inventories[0], inventories[i], *inventories[0].ns->FindClass(Name(*cls)), properties);
            if (!trouble.empty()) {
                return trouble;
            }
        }
    }
    return std::string();
}

}  // namespace

std::string TComparisonFault::Describe(const std::vector<TInventory>& inventories, TRules& rules) const
{
    std::string trouble;
    switch (status.GetStatus()) {
    case TZELStatusCode::kInitializationFailed:
        trouble = FindSystemTrouble(inventories);
        break;
    case TZELStatusCode::kTypeMismatch:
        trouble = FindFirst(inventories, rules, FindOtherType);
        break;
    case TZELStatusCode::kNotFound:
        trouble = FindFirst(inventories, rules, FindUndeclaredProperty);
        break;
    case TZELStatusCode::kSchemaMismatch:
        trouble = FindFirst(inventories, rules, FindUndeclaredClass);
        break;
    default:
        break;
    }
    return "the comparison failed: " + (log.empty() ? reason : log.back()) + (trouble.empty() ? "" : "; " + trouble) +
           (strictSchema ? "; without --strict-schema, cimdelta declares and makes what is missing" : "");
}

}  // namespace NORVZEL20

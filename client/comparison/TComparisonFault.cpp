// The plug-in ends a run with a status and a few words that name neither file nor class. The status says where to look:
//
//   kInitializationFailed (3)    before the walk: an operating system that is missing or has no usable OSType
//   kSchemaMismatch (37)         in the walk: a class that another inventory does not declare
//   any other                    at an instance or a pair of them: TFaultSearch
#include "client/comparison/TComparisonFault.h"

#include "client/comparison/TFaultSearch.h"
#include "client/inventory/CollectObjects.h"
#include "client/inventory/PropertyValue.h"
#include "embedded/value/TTypeKind.h"
#include "embedded/value/TValueText.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

using TCause = TFaultSearch::TCause;

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

// What is wrong with the declaration, if no value of it could be used.
std::string DescribeUnusableType(const TInMemClass& systems)
{
    const boost::shared_ptr<TInMemPropertyDecl> decl = systems.FindPropertyDecl(kOperatingSystemType);
    if (!decl) {
        return std::string("; the class declares no ") + kOperatingSystemType;
    }
    return TTypeKind::IsInteger(decl->GetType())
               ? std::string()
               : "; the class declares it as " + TValueText::DescribeType(decl->GetType()) + ", not as an integer";
}

// The cause of kInitializationFailed (3): the first inventory that lacks what the plug-in requires of it.
TCause FindSystemTrouble(const std::vector<TInventory>& inventories)
{
    for (const TInventory& inventory : inventories) {
        if (!inventory.ns->FindClass(kOperatingSystemClass)) {
            return {inventory.path + " declares no class " + kOperatingSystemClass, TFaultSearch::kCompleted};
        }
    }
    const boost::shared_ptr<TInMemClass> systems = inventories[0].ns->FindClass(kOperatingSystemClass);
    if (systems->GetInstanceCount() == 0) {
        return {inventories[0].path + " has no instance of " + kOperatingSystemClass, TFaultSearch::kCompleted};
    }
    // The plug-in gives the same status to everything that goes wrong here, a lack of memory included.
    if (HasUsableType(*systems)) {
        return {std::string("each inventory has its ") + kOperatingSystemClass +
                    ", but reading them failed; perhaps there was not enough memory",
                ""};
    }
    return {"the first " + std::string(kOperatingSystemClass) + " of " + inventories[0].path + " has no " + kOperatingSystemType +
                " between 0 and 65535" + DescribeUnusableType(*systems),
            ""};
}

// The cause of kSchemaMismatch (37): the first class, in the order of the walk, that another inventory does not declare although
// the reference has instances of it.
TCause FindUndeclaredClass(const std::vector<TInventory>& inventories, TRules& rules)
{
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*inventories[0].ns)) {
        const std::string& name = cls->GetName(TCallContext());
        for (std::size_t i = 1; i < inventories.size() && !rules.PropertiesOf(cls).empty(); ++i) {
            if (inventories[0].ns->FindClass(name)->GetInstanceCount() > 0 && !inventories[i].ns->FindClass(name)) {
                return {inventories[i].path + " does not declare class " + name + ", of which " + inventories[0].path +
                            " has instances",
                        TFaultSearch::kCompleted};
            }
        }
    }
    return {};
}

}  // namespace

std::string TComparisonFault::Describe(const std::vector<TInventory>& inventories, TRules& rules, TDeltaNamespace& records) const
{
    TCause cause;
    switch (status.GetStatus()) {
    case TZELStatusCode::kInitializationFailed:
        cause = FindSystemTrouble(inventories);
        break;
    case TZELStatusCode::kSchemaMismatch:
        cause = FindUndeclaredClass(inventories, rules);
        break;
    default:
        cause = TFaultSearch(inventories, rules).FindRefusedInstance(records, status);
        if (cause.text.empty()) {
            cause = TFaultSearch(inventories, rules).FindRefusedPair();
        }
        break;
    }
    if (cause.text.empty()) {
        return "the comparison failed: " + (log.empty() ? reason : log.back());
    }
    return "the comparison failed: " + cause.text +
           (strictSchema && !cause.remedy.empty() ? "; without --strict-schema, " + cause.remedy : "");
}

}  // namespace NORVZEL20

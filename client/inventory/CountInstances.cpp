#include "client/inventory/CountInstances.h"

#include "client/inventory/UncomparedSystems.h"
#include "embedded/value/TNameText.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

std::size_t CountOwnInstances(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes,
                              const std::string& className)
{
    std::size_t count = 0;
    for (const TInventory& inventory : inventories) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        count += cls ? cls->GetInstanceCount() : 0;
    }
    return TNameText::Equal(className, kOperatingSystemClass) ? count - FindMadeSystems(notes).size() : count;
}

std::size_t CountInstancesOfTree(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes,
                                 const std::string& className)
{
    // FindClass does not find the root class, which rules may name.
    const auto cls = boost::dynamic_pointer_cast<TInMemClass>(inventories.front().ns->GetClass(className, TCallContext()));
    std::size_t count = CountOwnInstances(inventories, notes, className);
    for (const boost::shared_ptr<TInMemClass>& below : cls->GetClassesBelow()) {
        count += CountOwnInstances(inventories, notes, below->GetName());
    }
    return count;
}

}  // namespace NORVZEL20

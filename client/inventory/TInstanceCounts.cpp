#include "client/inventory/TInstanceCounts.h"

#include "client/inventory/UncomparedSystems.h"
#include "host/RootClassName.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

std::size_t CountOf(const std::vector<TInventory>& inventories, const std::string& className)
{
    std::size_t count = 0;
    for (const TInventory& inventory : inventories) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        count += cls ? cls->GetInstanceCount() : 0;
    }
    return count;
}

}  // namespace

TInstanceCounts::TInstanceCounts(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes)
{
    const std::vector<boost::shared_ptr<TInMemClass>>& classes = inventories.front().ns->GetClasses();
    for (const boost::shared_ptr<TInMemClass>& cls : classes) {
        fCounts[cls->GetName()].own = CountOf(inventories, cls->GetName());
    }
    const auto systems = fCounts.find(std::string_view(kOperatingSystemClass));
    if (systems != fCounts.end()) {
        systems->second.own -= FindMadeSystems(notes).size();
    }
    // Subclasses come behind their superclasses, so a class is complete before it is added to the one above it.
    for (auto cls = classes.rbegin(); cls != classes.rend(); ++cls) {
        TCounts& counts = fCounts[(*cls)->GetName()];
        counts.tree += counts.own;
        fCounts[(*cls)->GetSuperInMemClass() ? (*cls)->GetSuperInMemClass()->GetName() : kRootClassName].tree += counts.tree;
    }
}

std::size_t TInstanceCounts::OfClass(const std::string& className) const
{
    const auto found = fCounts.find(std::string_view(className));
    return found == fCounts.end() ? 0 : found->second.own;
}

std::size_t TInstanceCounts::OfTree(const std::string& className) const
{
    const auto found = fCounts.find(std::string_view(className));
    return found == fCounts.end() ? 0 : found->second.tree;
}

}  // namespace NORVZEL20

#include "client/comparison/TValueDifference.h"

#include <algorithm>

namespace NORVZEL20 {

void TValueDifference::TGroup::Add(std::size_t inventory, std::size_t count)
{
    const auto found = std::lower_bound(inventories.begin(), inventories.end(), inventory);
    const auto at = found - inventories.begin();
    if (found != inventories.end() && *found == inventory) {
        instances.resize(inventories.size(), 1);
        instances[static_cast<std::size_t>(at)] += count;
        return;
    }
    if (count != 1 || !instances.empty()) {
        instances.resize(inventories.size(), 1);
        instances.insert(instances.begin() + at, count);
    }
    inventories.insert(found, inventory);
}

}  // namespace NORVZEL20

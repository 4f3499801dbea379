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

TValueDifference::TGroup& TValueDifference::GetGroup(const TCIMValue& value, const TEqual& areEqual)
{
    const auto found = std::find_if(others.begin(), others.end(), [&](const TGroup& group) {
        return group.value.GetType() == value.GetType() && areEqual(group.value, value);
    });
    if (found != others.end()) {
        return *found;
    }
    others.push_back({{}, value, {}});
    return others.back();
}

bool TValueDifference::DoOthersDiffer(const TEqual& areEqual) const
{
    return std::any_of(others.begin(), others.end(),
                       [&](const TGroup& group) { return !areEqual(others.front().value, group.value); });
}

}  // namespace NORVZEL20

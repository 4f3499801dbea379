#include "client/findings/ChangeIdentity.h"

#include <algorithm>

#include "client/text/DisplayText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

std::string WholeTextOf(const TCIMValue& value)
{
    return TValueText::DescribeType(value.GetType()) + (value.IsBag() ? " bag " : " ") + DisplayValue(value);
}

}  // namespace

std::string WholeText(const TValueDifference& change)
{
    std::string text = WholeTextOf(change.reference);
    for (const TValueDifference::TGroup& group : change.others) {
        text += '\n' + WholeTextOf(group.value);
        for (std::size_t i = 0; i < group.inventories.size(); ++i) {
            text += ' ' + std::to_string(group.inventories[i]) + 'x' + std::to_string(group.CountInstances(i));
        }
    }
    return text;
}

std::vector<std::size_t> InventoriesOf(const TValueDifference& change)
{
    std::vector<std::size_t> inventories;
    for (const TValueDifference::TGroup& group : change.others) {
        inventories.insert(inventories.end(), group.inventories.begin(), group.inventories.end());
    }
    std::sort(inventories.begin(), inventories.end());
    inventories.erase(std::unique(inventories.begin(), inventories.end()), inventories.end());
    return inventories;
}

}  // namespace NORVZEL20

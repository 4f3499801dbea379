#include "client/comparison/PutContent.h"

#include <algorithm>

namespace NORVZEL20 {

void PutContent(TDifference& difference, const std::string& property, const TCIMValue& value, TPropertyOrder& order)
{
    const auto isProperty = [&property](const auto& named) { return named.first == property; };
    if (std::any_of(difference.keys.begin(), difference.keys.end(), isProperty)) {
        return;
    }
    auto& contents = difference.contents;
    const auto known = std::find_if(contents.begin(), contents.end(), isProperty);
    if (known != contents.end() && !value.IsNull()) {
        known->second = value;
    } else if (known != contents.end()) {
        contents.erase(known);
    } else if (!value.IsNull()) {
        const std::map<std::string, std::size_t>& positions = order.Of(difference.className);
        const auto positionOf = [&positions](const std::string& name) {
            const auto found = positions.find(name);
            return found == positions.end() ? positions.size() : found->second;
        };
        const auto behind = std::find_if(contents.begin(), contents.end(),
                                         [&](const auto& content) { return positionOf(property) < positionOf(content.first); });
        contents.emplace(behind, property, value);
    }
}

}  // namespace NORVZEL20

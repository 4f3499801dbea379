#include "client/baseline/KeysOfInstance.h"

#include <algorithm>

#include "client/baseline/ForEachUnquoted.h"

namespace NORVZEL20 {

std::vector<TKeyText> KeysOfInstance(std::string_view instance)
{
    std::vector<TKeyText> keys;
    std::size_t end = instance.find('.');
    while (end < instance.size()) {
        const std::size_t begin = end + 1;
        const std::string_view rest = instance.substr(begin);
        std::size_t length = rest.size();
        int open = 0;  // braces of arrays
        ForEachUnquoted(rest, [&](std::size_t at) {
            open += rest[at] == '{' ? 1 : rest[at] == '}' ? -1 : 0;
            length = rest[at] == ',' && open <= 0 ? at : length;
            return length == rest.size();
        });
        const std::string_view key = rest.substr(0, length);
        const std::size_t equals = std::min(key.find('='), key.size());
        keys.push_back({key.substr(0, equals), key.substr(std::min(equals + 1, key.size())), begin});
        end = begin + length;
    }
    return keys;
}

}  // namespace NORVZEL20

#include "embedded/load/DropPlaces.h"

#include <string>
#include <utility>
#include <vector>

#include "embedded/value/ChangeReferences.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

void DropPlaces(TCIMValue& value)
{
    ChangeReferences(value, [](TCIMValue& reference) {
        TCIMReference path = reference;
        std::vector<std::pair<std::string, TCIMValue>> keys;
        path.EnumerateKeyBindings([&keys](const std::pair<std::string, TCIMValue>& key) {
            keys.push_back(key);
            return true;
        });
        for (auto& [name, key] : keys) {
            DropPlaces(key);
            path.AddKeyValue(name, key);
        }
        path.SetNamespaceName(std::string());
        path.SetHost(std::string());
        reference = TCIMValue(path);
        return true;
    });
}

}  // namespace NORVZEL20

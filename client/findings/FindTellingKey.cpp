// A key tells instances apart if no value of it goes with two different keys as a whole. Both are held as hashes; sorted by the
// value, two different wholes of one value stand side by side.
#include "client/findings/FindTellingKey.h"

#include <algorithm>
#include <boost/functional/hash.hpp>
#include <functional>
#include <utility>

#include "client/inventory/PropertyValue.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

const char kName[] = "Name";

using TKeyHashes = std::vector<std::pair<std::size_t, std::size_t>>;  // of one value, and of the whole key

TKeyHashes::value_type HashesOf(const ICIMInstance& instance, const std::vector<std::string>& keys, const std::string& candidate)
{
    TKeyHashes::value_type hashes;
    for (const std::string& key : keys) {
        const std::size_t hash = std::hash<std::string>()(ValueOf(instance, key).ToText());
        boost::hash_combine(hashes.second, hash);
        if (key == candidate) {
            hashes.first = hash;
        }
    }
    return hashes;
}

// Leaves each pair once.
bool AreApart(TKeyHashes& hashes)
{
    std::sort(hashes.begin(), hashes.end());
    hashes.erase(std::unique(hashes.begin(), hashes.end()), hashes.end());
    return std::adjacent_find(hashes.begin(), hashes.end(),
                              [](const auto& one, const auto& other) { return one.first == other.first; }) == hashes.end();
}

bool TellsApart(const std::vector<TInventory>& inventories, const std::string& className, const std::vector<std::string>& keys,
                const std::string& candidate)
{
    TKeyHashes hashes;
    for (const TInventory& inventory : inventories) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        const auto add = [&](const boost::shared_ptr<ICIMInstance>& instance) {
            hashes.push_back(HashesOf(*instance, keys, candidate));
            return true;
        };
        if (cls) {
            cls->EnumerateInstances(add, false, TCallContext());
        }
        if (!AreApart(hashes)) {
            return false;
        }
    }
    return true;
}

}  // namespace

std::string FindTellingKey(const std::vector<TInventory>& inventories, const std::string& className,
                           const std::vector<std::string>& keys)
{
    std::vector<std::string> telling;
    for (const std::string& key : keys) {
        if (TellsApart(inventories, className, keys, key)) {
            if (TNameText::Equal(key, kName)) {
                return key;
            }
            telling.push_back(key);
        }
    }
    return telling.size() == 1 ? telling.front() : std::string();
}

}  // namespace NORVZEL20

#include "client/comparison/TInstanceIndex.h"

#include <algorithm>
#include <map>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/FindDeclarations.h"

namespace NORVZEL20 {

namespace {

// Orders entries and hashes.
struct TByHash {
    template <class TEntry>
    bool operator()(const TEntry& a, const TEntry& b) const
    {
        return a.first < b.first;
    }
    template <class TEntry>
    bool operator()(const TEntry& entry, std::size_t hash) const
    {
        return entry.first < hash;
    }
};

}  // namespace

TInstanceIndex::TInstanceIndex(ICIMNamespace& ns, const std::string& className, TRules& rules)
    : TInstanceIndex(FindClass(ns, className), [className, &rules](const boost::shared_ptr<ICIMInstance>& instance) {
          return rules.KeyOf(className, instance);
      })
{}

TInstanceIndex::TInstanceIndex(const boost::shared_ptr<ICIMClass>& cls, TKeyOf keyOf) : fKeyOf(std::move(keyOf))
{
    if (!cls) {
        return;
    }
    TInstances instances = InstancesOf(*cls);
    fEntries.reserve(instances.size());
    for (boost::shared_ptr<ICIMInstance>& instance : instances) {
        const std::size_t hash = std::hash<std::string>()(fKeyOf(instance));
        fEntries.emplace_back(hash, std::move(instance));
    }
    std::stable_sort(fEntries.begin(), fEntries.end(), TByHash());
}

const TInstanceIndex::TInstances& TInstanceIndex::Find(const std::string& key)
{
    if (!fFound.empty() && key == fFoundBy) {
        return fFound;
    }
    fFound.clear();
    fFoundBy = key;
    const std::size_t hash = std::hash<std::string>()(key);
    for (auto entry = std::lower_bound(fEntries.begin(), fEntries.end(), hash, TByHash());
         entry != fEntries.end() && entry->first == hash; ++entry) {
        // Other keys may have the same hash.
        if (fKeyOf(entry->second) == key) {
            fFound.push_back(entry->second);
        }
    }
    return fFound;
}

void TInstanceIndex::ForEachKey(const TCallback& callback) const
{
    for (auto first = fEntries.begin(); first != fEntries.end();) {
        std::map<std::string, TInstances> byKey;
        const std::size_t hash = first->first;
        for (; first != fEntries.end() && first->first == hash; ++first) {
            byKey[fKeyOf(first->second)].push_back(first->second);
        }
        for (const auto& [key, instances] : byKey) {
            callback(key, instances);
        }
    }
}

}  // namespace NORVZEL20

// Every key and every pair of keys of a class is tried. What the instances are matched by without them, the plug-in says: it is
// asked with rules that exclude them. One set of rules serves for a trial of many classes, since they do not depend on each other.
#include "client/noise/FindVaryingKeys.h"

#include <algorithm>
#include <unordered_map>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/PropertyValue.h"

namespace NORVZEL20 {

namespace {

using TInstance = boost::shared_ptr<ICIMInstance>;
using TClass = TRulesDraft::TClass;

// The instances of a class of one inventory, by the keys that they are matched by.
struct TKeyed {
    std::vector<std::pair<std::string, TInstance>> all;
    std::unordered_map<std::string, TInstance> first;
};

std::vector<TKeyed> Key(const std::vector<TInventory>& inventories, TRules& rules, const std::string& className)
{
    std::vector<TKeyed> keyed;
    for (const TInventory& inventory : inventories) {
        keyed.emplace_back();
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        for (const TInstance& instance : cls ? InstancesOf(*cls) : std::vector<TInstance>()) {
            const std::string key = rules.KeyOf(className, instance);
            keyed.back().all.emplace_back(key, instance);
            keyed.back().first.emplace(key, instance);
        }
    }
    return keyed;
}

class TTrial {
  public:
    TTrial(const std::vector<TInventory>& inventories, TRules& rules, const TClass& cls)
        : fRules(rules), fClass(cls), fKeyed(Key(inventories, rules, cls.name))
    {}

    // Whether more than half of the instances of each inventory have a key of their own.
    bool TellsApart() const
    {
        return std::all_of(fKeyed.begin(), fKeyed.end(),
                           [](const TKeyed& keyed) { return keyed.all.empty() || keyed.first.size() * 2 > keyed.all.size(); });
    }

    // `before` is how the instances were matched until now.
    TVaryingKeys Match(const std::vector<TKeyed>& before) const
    {
        TVaryingKeys found;
        for (std::size_t other = 1; other < before.size(); ++other) {
            std::size_t lost = 0;
            for (std::size_t i = 0; i < before[0].all.size(); ++i) {
                if (before[other].first.count(before[0].all[i].first) == 0) {
                    ++lost;
                    found.matched += HasPartner(fKeyed[0].all[i], fKeyed[other]) ? 1 : 0;
                }
            }
            const auto added = static_cast<std::size_t>(
                std::count_if(before[other].all.begin(), before[other].all.end(),
                              [&before](const auto& entry) { return before[0].first.count(entry.first) == 0; }));
            found.unmatched += std::max(lost, added);
        }
        return found;
    }

  private:
    bool HasPartner(const std::pair<std::string, TInstance>& entry, const TKeyed& other) const
    {
        const auto partner = other.first.find(entry.first);
        return partner != other.first.end() && AreAlike(*entry.second, *partner->second);
    }

    bool AreAlike(const ICIMInstance& one, const ICIMInstance& other) const
    {
        std::size_t equal = 0;
        for (const std::string& property : fClass.compared) {
            equal += fRules.Differ(fClass.name, ValueOf(one, property), ValueOf(other, property)) ? 0 : 1;
        }
        return equal * 2 >= fClass.compared.size();
    }

    TRules& fRules;
    const TClass& fClass;
    const std::vector<TKeyed> fKeyed;
};

// The keys of the class that are not excluded, one by one and in pairs.
std::vector<std::vector<std::string>> ListTrials(const TClass& cls)
{
    std::vector<std::string> keys;
    std::copy_if(cls.keys.begin(), cls.keys.end(), std::back_inserter(keys),
                 [&cls](const std::string& key) { return std::count(cls.excludedKeys.begin(), cls.excludedKeys.end(), key) == 0; });
    std::vector<std::vector<std::string>> trials;
    for (const std::string& key : keys) {
        trials.push_back({key});
    }
    for (std::size_t i = 0; i < keys.size(); ++i) {
        for (std::size_t j = i + 1; j < keys.size(); ++j) {
            trials.push_back({keys[i], keys[j]});
        }
    }
    return trials;
}

}  // namespace

std::map<std::size_t, TVaryingKeys> FindVaryingKeys(const std::vector<TInventory>& inventories, TRules& rules,
                                                    const TRulesDraft& draft, const std::vector<std::size_t>& positions)
{
    std::map<std::size_t, std::vector<std::vector<std::string>>> trials;
    std::map<std::size_t, std::vector<TKeyed>> before;
    std::size_t most = 0;
    for (const std::size_t position : positions) {
        trials[position] = ListTrials(draft.GetClasses()[position]);
        before[position] = Key(inventories, rules, draft.GetClasses()[position].name);
        most = std::max(most, trials[position].size());
    }
    std::map<std::size_t, TVaryingKeys> found;
    for (std::size_t number = 0; number < most; ++number) {
        TRulesDraft tried = draft;
        for (const auto& [position, ofClass] : trials) {
            for (std::size_t i = 0; number < ofClass.size() && i < ofClass[number].size(); ++i) {
                tried.ExcludeKey(position, ofClass[number][i]);
            }
        }
        TRules meaning(inventories[0].ns, {"rules on trial", tried.Write({}), true});
        for (const auto& [position, ofClass] : trials) {
            const TClass& cls = tried.GetClasses()[position];
            if (number >= ofClass.size() || cls.compared.empty()) {
                continue;
            }
            const TTrial trial(inventories, meaning, cls);
            TVaryingKeys keys = trial.Match(before[position]);
            if (trial.TellsApart() && keys.matched * 2 >= keys.unmatched && keys.matched > found[position].matched) {
                keys.keys = ofClass[number];
                found[position] = keys;
            }
        }
    }
    for (auto entry = found.begin(); entry != found.end();) {
        entry = entry->second.keys.empty() ? found.erase(entry) : std::next(entry);
    }
    return found;
}

}  // namespace NORVZEL20

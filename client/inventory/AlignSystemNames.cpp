#include "client/inventory/AlignSystemNames.h"

#include <algorithm>
#include <cstddef>
#include <set>
#include <string>
#include <utility>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/FindOwnName.h"
#include "client/inventory/TNameReplacement.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TKeyTexts.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

// Names that mean one system, in the order of the options.
using TNames = std::vector<std::string>;

TNames Split(const std::string& option)
{
    TNames names;
    for (std::size_t start = 0; start <= option.size();) {
        const std::size_t end = std::min(option.find('=', start), option.size());
        names.push_back(option.substr(start, end - start));
        start = end + 1;
    }
    if (names.size() < 2 || std::count(names.begin(), names.end(), "") > 0) {
        throw TClientError("--same " + EscapeForDisplay(option) +
                           " is no list of names; join names that mean one system by equals signs: --same web01=web02");
    }
    if (std::count(names.begin(), names.end(), names.front()) == static_cast<std::ptrdiff_t>(names.size())) {
        throw TClientError("--same " + EscapeForDisplay(option) +
                           " names one name only; join different names that mean one system: --same web01=web02");
    }
    return names;
}

bool HasName(const TNames& names, const std::string& name)
{
    return std::any_of(names.begin(), names.end(), [&name](const std::string& known) { return TNameText::Equal(known, name); });
}

// Options with a common name are about one system.
std::vector<TNames> ReadSame(const std::vector<std::string>& options)
{
    std::vector<TNames> systems;
    for (const std::string& option : options) {
        TNames names = Split(option);
        for (auto system = systems.begin(); system != systems.end();) {
            const bool isSame =
                std::any_of(names.begin(), names.end(), [&](const std::string& name) { return HasName(*system, name); });
            if (isSame) {
                names.insert(names.begin(), system->begin(), system->end());
            }
            system = isSame ? systems.erase(system) : system + 1;
        }
        TNames once;
        for (const std::string& name : names) {
            if (!HasName(once, name)) {
                once.push_back(name);
            }
        }
        systems.push_back(once);
    }
    return systems;
}

// How often each name comes, in the spelling that comes first.
using TNameCounts = TNameMap<std::size_t>;
using TNameCount = TNameCounts::value_type;

void CountIfAsked(TNameCounts& counts, std::string_view text, const std::vector<TNames>& asked)
{
    const std::string name(text);
    if (std::any_of(asked.begin(), asked.end(), [&name](const TNames& names) { return HasName(names, name); })) {
        ++counts[name];
    }
}

// How often an inventory has the names of `asked` in its keys and references.
TNameCounts CountNames(const TInventory& inventory, const std::vector<TNames>& asked)
{
    TNameCounts counts;
    TKeyTexts(*inventory.ns).Change([&](std::string_view text, const TKeyTexts::TPlace&) {
        CountIfAsked(counts, text, asked);
        return TCIMValue();
    });
    return counts;
}

// How often an inventory has them as values of any property.
TNameCounts CountValues(const TInventory& inventory, const std::vector<TNames>& asked)
{
    TNameCounts counts;
    for (const boost::shared_ptr<TInMemClass>& cls : inventory.ns->GetClasses()) {
        for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(*cls)) {
            for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
                const TCIMValue& value = static_cast<const TInMemInstance&>(*instance).GetSlotValue(slot);
                if (value.GetType() == TCIMValue::TCIMType::kString && !value.IsNull() && !value.GetEmbeddedObject()) {
                    CountIfAsked(counts, value.GetString(), asked);
                }
            }
        }
    }
    return counts;
}

// Finds the own names of inventories among names that mean the same.
class TSameNames {
  public:
    TSameNames(std::vector<TInventory>& inventories, const std::vector<std::string>& options)
        : fInventories(inventories), fSystems(ReadSame(options))
    {
        for (const TInventory& inventory : fInventories) {
            fKeys.push_back(CountNames(inventory, fSystems));
            fValues.push_back(CountValues(inventory, fSystems));
        }
    }

    // Gives each inventory its own names.
    void Run()
    {
        for (const TNames& names : fSystems) {
            const std::string used = FindOwn(0, names);
            if (used.empty()) {
                throw TClientError(fInventories[0].path + ": has none of the names " + Listed(names) +
                                   ", neither in its keys and references nor as a value; it is the reference, whose name all get");
            }
            for (std::size_t i = 0; i < fInventories.size(); ++i) {
                const std::string own = i == 0 ? used : FindOwn(i, names);
                if (!own.empty()) {
                    fInventories[i].ownNames.push_back({own, used});
                }
            }
            RequireAll(names);
        }
    }

  private:
    static std::string Listed(const TNames& names)
    {
        std::string list;
        for (const std::string& name : names) {
            list += (list.empty() ? "" : ", ") + DisplayLabel(name);
        }
        return list;
    }

    // Which of several names is the own one is not to be guessed. `place` says where they were counted.
    static void RefuseTie(const TInventory& inventory, const TNames& names, const TNameCounts& counts, const TNameCount& own,
                          const std::string& place)
    {
        for (const std::string& name : names) {
            const auto found = counts.find(name);
            if (found != counts.end() && found->second == own.second && !TNameText::Equal(found->first, own.first)) {
                throw TClientError(inventory.path + ": has the names " + EscapeForDisplay(own.first) + " and " +
                                   EscapeForDisplay(found->first) + " equally often " + place +
                                   ", so its own one is not known; use --self");
            }
        }
    }

    // The one of the names that comes most often, as the inventory spells it; empty if none does.
    static std::string FindMostFrequent(const TInventory& inventory, const TNames& names, const TNameCounts& counts,
                                        const std::string& place)
    {
        auto own = counts.end();
        for (const std::string& name : names) {
            const auto found = counts.find(name);
            if (found != counts.end() && (own == counts.end() || found->second > own->second)) {
                own = found;
            }
        }
        if (own == counts.end()) {
            return std::string();
        }
        RefuseTie(inventory, names, counts, *own, place);
        return own->first;
    }

    // The inventory's own name as it spells it; empty if it has none of them. Where no key holds them, values decide: first the one
    // that is the system's name, since another system may be named more often.
    std::string FindOwn(std::size_t i, const TNames& names)
    {
        const TInventory& inventory = fInventories[i];
        const std::string inKeys = FindMostFrequent(inventory, names, fKeys[i], "in its keys and references");
        if (!inKeys.empty()) {
            return inKeys;
        }
        if (HasName(names, inventory.label)) {
            fLabels.insert(inventory.label);
            return FindOwnName(inventory, kSystemNameProperty);
        }
        const std::string own = FindOwnNameIfAny(inventory);
        return HasName(names, own) ? own : FindMostFrequent(inventory, names, fValues[i], "as values");
    }

    // A name that is nowhere is a mistake in writing.
    void RequireAll(const TNames& names) const
    {
        for (const std::string& name : names) {
            const auto hasName = [&name](const TNameCounts& counts) { return counts.count(name) > 0; };
            const bool isSomewhere = fLabels.count(name) > 0 || std::any_of(fKeys.begin(), fKeys.end(), hasName) ||
                                     std::any_of(fValues.begin(), fValues.end(), hasName);
            if (!isSomewhere) {
                throw TClientError("no inventory has the name " + DisplayLabel(name) +
                                   " of --same in its keys and references, as a value or as its label; letter case does not count");
            }
        }
    }

    std::vector<TInventory>& fInventories;
    std::vector<TNames> fSystems;
    std::vector<TNameCounts> fKeys;    // of each inventory, in keys and references
    std::vector<TNameCounts> fValues;  // the same, as values
    std::set<std::string, TNameText::TLess> fLabels;
};

void Replace(TInventory& inventory)
{
    TNames ownNames;
    for (const TOwnName& own : inventory.ownNames) {
        ownNames.push_back(own.name);
    }
    const TNameCounts counts = CountNames(inventory, {ownNames});
    for (TOwnName& own : inventory.ownNames) {
        own.isInKeys = counts.count(own.name) > 0;
    }
    TNameReplacement replacement(inventory.ownNames);
    const std::string twice = TKeyTexts(*inventory.ns).Change([&](std::string_view text, const TKeyTexts::TPlace& place) {
        return replacement.Replace(text, place);
    });
    if (!twice.empty()) {
        throw TClientError(inventory.path + ": two instances would be " + twice +
                           " with the system's name as the reference has it; they differ only in the letter case of that name");
    }
}

// Notes names of the reference that no inventory has another name for, so that nothing was replaced.
void MarkCommonNames(std::vector<TInventory>& inventories)
{
    for (TOwnName& used : inventories.front().ownNames) {
        const auto isChanged = [&used](const TOwnName& own) {
            return own.comparedAs == used.name && (own.replaced + own.marked > 0 || !TNameText::Equal(own.name, used.name));
        };
        used.isCommon = std::none_of(inventories.begin(), inventories.end(), [&isChanged](const TInventory& inventory) {
            return std::any_of(inventory.ownNames.begin(), inventory.ownNames.end(), isChanged);
        });
    }
}

}  // namespace

void CheckSystemNames(const TSystemNames& options)
{
    ReadSame(options.same);
}

void AlignSystemNames(std::vector<TInventory>& inventories, const TSystemNames& options)
{
    if (!options.self.empty()) {
        const std::string used = FindOwnName(inventories.front(), options.self);
        for (TInventory& inventory : inventories) {
            inventory.ownNames.push_back({FindOwnName(inventory, options.self), used});
        }
    }
    if (!options.same.empty()) {
        TSameNames(inventories, options.same).Run();
    }
    for (TInventory& inventory : inventories) {
        if (!inventory.ownNames.empty()) {
            Replace(inventory);
        }
    }
    if (!options.same.empty()) {
        MarkCommonNames(inventories);
    }
}

}  // namespace NORVZEL20

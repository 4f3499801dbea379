#pragma once

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <string>
#include <utility>
#include <vector>

#include "client/comparison/TValueDifference.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// One difference between the reference and the others.
struct TDifference {
    enum EKind {
        kOnlyInReference,  ///< an instance that the reference has and `inventories` lack
        kOnlyInOthers,     ///< an instance that `inventories` have and the reference lacks
        kChanged           ///< a property whose value in `inventories` is not the reference's
    };

    EKind kind;
    bool hasKeys = true;  ///< whether the class has keys; otherwise it has one instance at most
    std::string className;
    std::string instance;                                 ///< the key by which instances were matched, as path text
    std::vector<std::pair<std::string, TCIMValue>> keys;  ///< the same, key by key, in the class's order
    std::string path;                      ///< only of kOnlyInReference, if the rules of the class exclude keys: the whole path
    std::vector<std::size_t> inventories;  ///< the positions of those that differ, ascending, each once
    /// For each inventory of the run, how many instances have the key. Empty if the rules exclude no key, so no two instances share
    /// one.
    std::vector<std::size_t> sharing;
    /// Of kChanged: the property, and nothing else. Of kOnlyInOthers: each compared property in which the instances of
    /// `inventories` differ from one another, ascending by name.
    std::vector<TValueDifference> values;
    /// Of an instance that only one side has: the compared properties that are not null and no keys, in the order of the class,
    /// with the values of the reference or of the first of `inventories`.
    std::vector<std::pair<std::string, TCIMValue>> contents;

    /// The instance's key without the class: `Key1="v",Key2=5`; empty if the class has no keys or the rules exclude all of them.
    std::string GetKeyText() const
    {
        return instance.size() > className.size() ? instance.substr(className.size() + 1) : std::string();
    }

    /// How many instances of the inventory share the key; 0 if only one has it, or none.
    std::size_t CountSharing(std::size_t inventory) const
    {
        return sharing.empty() || sharing[inventory] < 2 ? 0 : sharing[inventory];
    }

    /// Whether instances of any inventory of the run share the key, those that agree with the reference included.
    bool IsKeyShared() const
    {
        return std::any_of(sharing.begin(), sharing.end(), [](std::size_t count) { return count > 1; });
    }

    /// Those of the reference and `inventories` in which instances share the key, ascending.
    std::vector<std::size_t> GetSharing() const
    {
        std::vector<std::size_t> found;
        if (CountSharing(0) > 0) {
            found.push_back(0);
        }
        std::copy_if(inventories.begin(), inventories.end(), std::back_inserter(found),
                     [this](std::size_t inventory) { return CountSharing(inventory) > 0; });
        return found;
    }

    /// How many instances the difference is about: as many as the inventory has that has most instances with the key.
    std::size_t CountInstances() const { return CountInstances(inventories); }

    /// The same for some of its inventories.
    std::size_t CountInstances(const std::vector<std::size_t>& someInventories) const
    {
        std::size_t most = 1;
        for (const std::size_t inventory : someInventories) {
            most = std::max(most, CountSharing(inventory));
        }
        return most;
    }
};

}  // namespace NORVZEL20

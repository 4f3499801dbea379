#pragma once

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// One difference between the reference and the others.
struct TDifference {
    enum EKind {
        kOnlyInReference,  ///< an instance that the reference has and `inventories` lack
        kOnlyInOthers,     ///< an instance that `inventories` have and the reference lacks
        kChanged           ///< a property whose value in `inventories` is not the reference's
    };

    /// One value and the inventories that have it.
    struct TGroup {
        std::vector<std::size_t> inventories;  ///< ascending
        TCIMValue value;
    };

    EKind kind;
    std::string className;
    std::string instance;                                 ///< the key by which instances were matched, as path text
    std::vector<std::pair<std::string, TCIMValue>> keys;  ///< the same, key by key, in the class's order
    std::string property;                                 ///< only of kChanged
    std::vector<std::size_t> inventories;                 ///< the positions of those that differ, ascending, each once
    TCIMValue reference;                                  ///< only of kChanged: the reference's value before the run
    std::vector<TGroup> others;                           ///< only of kChanged: the values of `inventories`, equal ones together

    /// The instance's key without the class: `Key1="v",Key2=5`; empty if the rules exclude every key.
    std::string GetKeyText() const
    {
        return instance.size() > className.size() ? instance.substr(className.size() + 1) : std::string();
    }
};

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

#include "embedded/load/TLoadPlace.h"
#include "embedded/mof/TMofValue.h"

namespace NORVZEL20 {

/// An instance as a document declares it. Its values have no types before its class is declared.
struct TMofInstance {
    struct TProperty {
        std::string name;
        TMofValue value;
        TLoadPlace place;
    };

    std::string className;
    std::string alias;  ///< without its dollar sign; empty for none
    TLoadPlace place;
    std::vector<TProperty> properties;

    /// The property of that name, in any letter case; null if there is none. Linear.
    const TProperty* FindProperty(const std::string& name) const noexcept;
};

}  // namespace NORVZEL20

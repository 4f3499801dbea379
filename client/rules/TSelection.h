#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// What a person selects for a comparison by names, in which `*` and `?` are wildcards.
struct TSelection {
    std::vector<std::string> classes;       ///< CLASS: it and the classes below it; empty: all of them
    std::vector<std::string> properties;    ///< NAME or CLASS.NAME; empty: all of them
    std::vector<std::string> excluded;      ///< CLASS or CLASS.NAME
    std::vector<std::string> excludedKeys;  ///< KEY or CLASS.KEY

    bool IsEmpty() const { return classes.empty() && properties.empty() && excluded.empty() && excludedKeys.empty(); }
};

}  // namespace NORVZEL20

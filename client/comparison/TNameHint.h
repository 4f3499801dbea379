#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// The finding that no instance of a class matches, and that a key has one value in each inventory.
struct TNameHint {
    std::string className;
    std::string property;                ///< the key, as the reference spells it
    std::vector<std::size_t> instances;  ///< of the class in each inventory
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

#include "client/comparison/TDifference.h"

namespace NORVZEL20 {

/// Instances of a class that the same inventories lack, or that only the same inventories have.
struct TPresenceFinding {
    /// One of them.
    struct TExample {
        std::string name;                                         ///< see TShortNames
        std::vector<std::pair<std::string, TCIMValue>> contents;  ///< see TDifference::contents
        std::string path;                                         ///< see TDifference::instance
    };

    TDifference::EKind kind;               ///< kOnlyInReference or kOnlyInOthers
    std::vector<std::size_t> inventories;  ///< see TDifference::inventories
    std::size_t instances = 0;
    std::size_t disagreeing = 0;     ///< of how many of them the inventories that have them hold different values
    std::vector<TExample> examples;  ///< the first of them, in the order of the differences
};

}  // namespace NORVZEL20

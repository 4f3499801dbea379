#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TValueDifference.h"

namespace NORVZEL20 {

/// One change of one property, and the instances in which it is the same.
struct TChangeFinding {
    TValueDifference change;         ///< the property, the reference's value and the others'; without parts
    std::size_t instances = 0;       ///< how many instances have it
    std::vector<std::string> names;  ///< of the first of them, in the order of the differences; see TShortNames
    bool isShared = false;           ///< whether instances of one inventory share a key in any of them
};

}  // namespace NORVZEL20

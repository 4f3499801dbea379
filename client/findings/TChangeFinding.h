#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TValueDifference.h"

namespace NORVZEL20 {

/// One change of one property, and the instances in which it is the same.
struct TChangeFinding {
    TValueDifference change;    ///< the property, the reference's value and the others'; without parts
    std::size_t instances = 0;  ///< how many instances have it
    /// Some of them, in the order of the differences: the first ones, unless a property has more distinct changes than examples are
    /// kept. See TShortNames.
    std::vector<std::string> names;
    std::vector<std::string> paths;    ///< the same, as TDifference::instance has them
    std::vector<std::size_t> sharing;  ///< the inventories in which several instances have the key of any of them, ascending
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TDifferenceCounts.h"

namespace NORVZEL20 {

/// The differences of one class, counted for a page.
struct TPageClass {
    std::string name;
    TDifferenceCounts counts;
    std::vector<std::size_t> differences;  ///< for each inventory, in how many it takes part
    std::vector<std::size_t> instances;    ///< for each inventory, how many instances these are about
};

}  // namespace NORVZEL20

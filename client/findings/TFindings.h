#pragma once

#include <cstddef>
#include <vector>

#include "client/findings/TClassFindings.h"

namespace NORVZEL20 {

/// What a comparison found, by class.
struct TFindings {
    std::vector<TClassFindings> classes;   ///< in ascending order of their names
    std::vector<std::size_t> differences;  ///< for each inventory, in how many differences it takes part; 0 for the reference
};

}  // namespace NORVZEL20

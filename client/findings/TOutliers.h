#pragma once

#include <cstddef>
#include <vector>

#include "client/findings/TClassFindings.h"

namespace NORVZEL20 {

/// Inventories, and what they and no others have otherwise than the reference.
struct TOutliers {
    std::vector<std::size_t> inventories;  ///< their positions in the report, ascending
    std::size_t differences = 0;
    std::vector<TClassFindings> classes;  ///< as of a comparison of the reference with one of them; ascending by name
};

}  // namespace NORVZEL20

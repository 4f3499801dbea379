#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// How many differences of each kind there are.
struct TDifferenceCounts {
    std::size_t onlyInReference = 0;
    std::size_t onlyInOthers = 0;
    std::size_t changedValues = 0;
    std::size_t changedInstances = 0;       ///< the instances that the changed values belong to
    std::size_t instancesOnlyInOthers = 0;  ///< the sum of TDifference::CountInstances of those that onlyInOthers counts

    std::size_t GetTotal() const { return onlyInReference + onlyInOthers + changedValues; }
};

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

#include "client/comparison/TDifferenceCounts.h"
#include "client/findings/TPresenceFinding.h"
#include "client/findings/TPropertyFinding.h"

namespace NORVZEL20 {

/// What was found in the instances of one class.
struct TClassFindings {
    std::string className;
    TDifferenceCounts counts;                  ///< instancesOnlyInOthers is not counted
    std::vector<TPresenceFinding> presences;   ///< those of the reference first; then in the order of the differences
    std::vector<TPropertyFinding> properties;  ///< ascending by name; of the same name, those with fewest changes first
};

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "client/comparison/TDifferenceCounts.h"

namespace NORVZEL20 {

/// Differences that were found and that an option keeps out of the report.
struct TNotShown {
    TDifferenceCounts counts;
    std::string option;  ///< as a person types it; empty if there is none
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// What a MOF document may have at most, beside what TSchemaLimits says. A document that exceeds a bound is in error.
struct TMofLimits {
    TMofLimits() = delete;

    static constexpr std::size_t kMaxBytes = 256u << 20;  ///< of one document
    static constexpr std::size_t kMaxIncludeDepth = 32;   ///< documents that include each other
    static constexpr std::size_t kMaxIncluded = 100000;   ///< files that a load reads because documents include them
    static constexpr std::size_t kMaxPathDepth = 12;      ///< aliases in keys of each other's instances
};

}  // namespace NORVZEL20

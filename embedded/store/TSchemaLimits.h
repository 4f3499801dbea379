#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// The most that classes made from what others wrote may have of anything whose cost adds up: many times what any published schema
/// has. Counts include what is inherited.
struct TSchemaLimits {
    static constexpr std::size_t kMaxSuperClasses = 1000;  ///< of a class; whoever walks a class tree may do so recursively
    static constexpr std::size_t kMaxProperties = 1024;    ///< of a class, an instance or an embedded object
    static constexpr std::size_t kMaxMethods = 1024;       ///< of a class, overridden ones included
    static constexpr std::size_t kMaxQualifiers = 1024;    ///< of an element, restated ones included
    static constexpr std::size_t kMaxKeyBindings = 256;    ///< of a path
};

}  // namespace NORVZEL20

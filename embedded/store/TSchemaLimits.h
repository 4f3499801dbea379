#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// The bounds for classes that come from a document. They keep a document from taking too much memory or time. They are many times
/// what any published schema has. Counts include what is inherited.
struct TSchemaLimits {
    static constexpr std::size_t kMaxSuperClasses = 1000;  ///< of a class; so a class tree may be walked by recursion
    static constexpr std::size_t kMaxProperties = 1024;    ///< of a class, an instance or an embedded object
    static constexpr std::size_t kMaxMethods = 1024;       ///< of a class, overridden ones included
    static constexpr std::size_t kMaxQualifiers = 1024;    ///< of an element, restated ones included
    static constexpr std::size_t kMaxKeyBindings = 256;    ///< of a path
};

}  // namespace NORVZEL20

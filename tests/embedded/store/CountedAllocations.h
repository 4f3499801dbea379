#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// How many times this program has called operator new so far.
std::size_t CountedAllocations() noexcept;

}  // namespace NORVZEL20

#pragma once

#include <atomic>
#include <cstdint>

namespace NORVZEL20 {

/// How many bytes were read. Written by the thread that reads, once for each read; may be read by any.
using TByteCount = std::atomic<std::uint64_t>;

}  // namespace NORVZEL20

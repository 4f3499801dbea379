#pragma once

#include <cstdint>

namespace NORVZEL20 {

/// Counts the bytes that the XML library scans. With it, tests bound the work of reading without a clock.
///
/// The library scans a tag that has not ended again with each piece that it gets; those bytes count each time.
/// In the test program, functions of this meter stand in front of the library's own. Threads: one parse at a time.
class TScanMeter {
  public:
    /// Counts from now on.
    TScanMeter();

    /// The bytes scanned, repeated ones included.
    std::uint64_t GetScanned() const;
    /// The bytes given to the library, each once.
    std::uint64_t GetGiven() const;
};

}  // namespace NORVZEL20

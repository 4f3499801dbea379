#pragma once

#include <cstdint>

namespace NORVZEL20 {

/// Counts the bytes that the XML library looks at, so that tests bound the work of reading without a clock.
///
/// The library begins a tag that has not ended yet anew with each piece it is given: those bytes count again each time.
/// Stands in front of the library's own functions in the test program. Threads: one parse at a time.
class TScanMeter {
  public:
    /// Counts from now on.
    TScanMeter();

    /// The bytes looked at, all of them.
    std::uint64_t GetScanned() const;
    /// The bytes handed over, each once.
    std::uint64_t GetGiven() const;
};

}  // namespace NORVZEL20

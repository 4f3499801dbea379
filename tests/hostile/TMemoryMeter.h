#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// Counts what the whole process allocates, C libraries included, so that tests bound memory and work without a clock.
///
/// Replaces the C library's malloc in the test program, or asks the sanitizer that has replaced it already.
class TMemoryMeter {
  public:
    /// Counts from now on. Errors: std::logic_error where the sanitizer tells nothing, so that no bound holds for want of counting.
    TMemoryMeter();

    /// The most bytes that were in use at a time, beyond those at the start.
    std::size_t GetPeak() const;
    /// All bytes that were allocated, freed ones included.
    std::size_t GetTotal() const;

  private:
    std::ptrdiff_t fInUseAtStart;
    std::size_t fTotalAtStart;
};

}  // namespace NORVZEL20

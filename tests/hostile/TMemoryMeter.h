#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// Counts what the whole process allocates, C libraries included. With it, tests bound memory and work without a clock.
///
/// It replaces the C library's malloc in the test program, or uses the hooks of a sanitizer that has replaced malloc already.
class TMemoryMeter {
  public:
    /// Counts from now on. Errors: std::logic_error if the sanitizer reports nothing; otherwise all bounds would hold.
    TMemoryMeter();

    /// The most bytes that were in use at a time, beyond those at the start.
    std::size_t GetPeak() const;
    /// The bytes that are in use now, beyond those at the start; negative if memory from before the start was freed.
    std::ptrdiff_t GetInUse() const;
    /// All bytes that were allocated, freed ones included.
    std::size_t GetTotal() const;

  private:
    std::ptrdiff_t fInUseAtStart;
    std::size_t fTotalAtStart;
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// Bytes that come one piece after the other: of a file, or decompressed from another source.
///
/// Threads: one at a time for each source.
class IByteSource {
  public:
    virtual ~IByteSource() = default;

    /// Fills `buffer` with at most `size` bytes and returns how many there were; 0 at the end, and only there.
    /// Errors: TClientError that names the file and the reason; std::bad_alloc.
    virtual std::size_t Read(char* buffer, std::size_t size) = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// A stream of bytes: those of a file, or decompressed from another source.
///
/// Threads: use a source from one thread at a time; different sources may be used concurrently.
class IByteSource {
  public:
    virtual ~IByteSource() = default;

    /// Reads at most `size` bytes into `buffer` and returns how many. 0 means the end; fewer than `size` does not.
    /// Errors: TClientError that names the file and the reason; std::bad_alloc.
    virtual std::size_t Read(char* buffer, std::size_t size) = 0;
};

}  // namespace NORVZEL20

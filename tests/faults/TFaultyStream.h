#pragma once

#include <cstdio>
#include <limits>
#include <string>

namespace NORVZEL20 {

/// A file that delivers small pieces, or an error in its middle.
class TFaultyStream {
  public:
    static constexpr std::size_t kNever = std::numeric_limits<std::size_t>::max();

    /// Delivers at most `pieceLength` bytes at a time. Reads at or after offset `errorAt` fail with EIO, `errors` times.
    TFaultyStream(std::string contents, std::size_t pieceLength, std::size_t errorAt = kNever, int errors = 1000);
    TFaultyStream(const TFaultyStream&) = delete;
    TFaultyStream& operator=(const TFaultyStream&) = delete;
    /// Closes the file if it is still open.
    ~TFaultyStream();

    /// Call this once.
    std::FILE* Open();
    bool IsOpen() const { return fFile != nullptr; }

  private:
    static ssize_t Read(void* self, char* buffer, std::size_t size);
    static int Close(void* self);

    std::string fContents;
    std::size_t fPieceLength;
    std::size_t fErrorAt;
    int fErrors;
    std::size_t fPosition = 0;
    std::FILE* fFile = nullptr;
};

}  // namespace NORVZEL20

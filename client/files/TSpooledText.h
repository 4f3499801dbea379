#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

#include "client/process/TDescriptor.h"

namespace NORVZEL20 {

/// A text that is put together piece by piece, and read from its beginning when it is complete.
///
/// About kMostInMemory bytes of it are in memory, the rest in a temporary file (see BeginOfTemporaryFiles). The file has no name,
/// so nothing of it is left however the process ends. If none can be made, or if it takes no more, the rest stays in memory.
class TSpooledText {
  public:
    /// A text of up to this size makes no file.
    static constexpr std::size_t kMostInMemory = 1U << 20U;

    using TCallback = std::function<void(std::string_view)>;

    TSpooledText() = default;
    TSpooledText(const TSpooledText&) = delete;
    TSpooledText& operator=(const TSpooledText&) = delete;

    /// Errors: std::bad_alloc; the text is as before then.
    void Append(std::string_view piece);

    /// Calls back with the whole text, piece by piece. Errors: TClientError if the file cannot be read; what the callback throws.
    void ForEachPiece(const TCallback& callback) const;

    /// Copies at most `size` bytes of the text from that place on, and returns how many; 0 means its end or a size of 0. Errors:
    /// TClientError if the file cannot be read.
    std::size_t ReadAt(std::uint64_t place, char* buffer, std::size_t size) const;

  private:
    void MoveToFile() noexcept;
    void ReadFile(const TCallback& callback) const;
    std::size_t ReadFileAt(std::uint64_t place, char* buffer, std::size_t size) const;

    std::string fTail;           // what is behind the text in the file
    std::uint64_t fInFile = 0;   // the length of the text in the file; more may be there, of a piece that did not fit
    TDescriptor fFile;           // open if there is a file
    bool fIsFileClosed = false;  // whether nothing more is put into the file
};

}  // namespace NORVZEL20

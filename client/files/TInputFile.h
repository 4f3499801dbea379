#pragma once

#include <string>
#include <vector>

#include "client/files/IByteSource.h"
#include "client/files/TByteCount.h"

namespace NORVZEL20 {

/// What messages call an input: its path, or "standard input" for "-".
std::string NameOfInput(const std::string& path);

/// The bytes of a file, or of standard input, as they are.
class TInputFile : public IByteSource {
  public:
    /// Opens the file, or standard input for "-". `count`, which may be null and otherwise must outlive this, is increased by what
    /// is read. Errors: TClientError if it cannot be opened, is a directory or is a standard input that is closed.
    explicit TInputFile(const std::string& path, TByteCount* count = nullptr);
    TInputFile(const TInputFile&) = delete;
    TInputFile& operator=(const TInputFile&) = delete;
    ~TInputFile() override;

    std::size_t Read(char* buffer, std::size_t size) override;

    /// The first `count` bytes of the file, or all of them if there are fewer; Read returns them again. Call this at most once,
    /// and before Read. Errors: those of Read.
    const std::string& Peek(std::size_t count);

    /// NameOfInput of the file.
    const std::string& GetName() const { return fName; }

  private:
    std::size_t ReadDescriptor(char* buffer, std::size_t size);

    std::string fName;
    int fDescriptor;
    TByteCount* const fCount;
    std::string fPeeked;
    std::size_t fDelivered = 0;  // how many of the peeked bytes Read has returned
};

/// Throws TClientError if more than one of the paths is "-".
void RequireOneStandardInput(const std::vector<std::string>& paths);

}  // namespace NORVZEL20

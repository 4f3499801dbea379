#pragma once

#include <string>

#include "client/files/IByteSource.h"

namespace NORVZEL20 {

/// A file as it lies on the disk, or standard input.
class TInputFile : public IByteSource {
  public:
    /// Opens the file, or standard input for "-". Errors: TClientError where it cannot be opened or is a directory.
    explicit TInputFile(const std::string& path);
    TInputFile(const TInputFile&) = delete;
    TInputFile& operator=(const TInputFile&) = delete;
    ~TInputFile() override;

    std::size_t Read(char* buffer, std::size_t size) override;

    /// The first bytes of the file, which Read delivers nevertheless; fewer than `count` where it has no more. To be called once,
    /// before Read.
    const std::string& Peek(std::size_t count);

    /// What messages call the file: its path, or "standard input".
    const std::string& GetName() const { return fName; }

  private:
    std::size_t ReadDescriptor(char* buffer, std::size_t size);

    std::string fName;
    int fDescriptor;
    std::string fPeeked;
    std::size_t fDelivered = 0;  // of what was peeked
};

}  // namespace NORVZEL20

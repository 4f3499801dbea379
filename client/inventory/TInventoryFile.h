#pragma once

#include <memory>
#include <string>

#include "client/files/IByteSource.h"
#include "client/files/TInputFile.h"

namespace NORVZEL20 {

/// The text of an inventory file: plain, or decompressed from gzip, xz or zstd, which its first bytes tell.
///
/// Threads: distinct files at once.
class TInventoryFile : public IByteSource {
  public:
    /// Opens the file, or standard input for "-". Errors: TClientError where it cannot be opened, is a directory or is compressed
    /// otherwise; as of Read.
    explicit TInventoryFile(const std::string& path);

    /// Errors: also TClientError where the compressed data is damaged, ends early or has something else behind it.
    std::size_t Read(char* buffer, std::size_t size) override;

    /// To be called where the text makes no sense: reads on, so that damage of compressed data is told rather than what came of it.
    /// Errors: as of Read. Cost: at most 1 GiB is decompressed.
    void CheckRest();

    /// What messages call the file: its path, or "standard input".
    const std::string& GetName() const { return fFile.GetName(); }

  private:
    TInputFile fFile;
    std::unique_ptr<IByteSource> fText;  // null where the file is plain
};

}  // namespace NORVZEL20

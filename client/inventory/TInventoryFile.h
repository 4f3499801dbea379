#pragma once

#include <memory>
#include <string>

#include "client/files/IByteSource.h"
#include "client/files/TInputFile.h"

namespace NORVZEL20 {

/// The text of an inventory file: plain, or decompressed from gzip, xz or zstd. The first bytes decide, not the name.
///
/// Threads: as IByteSource.
class TInventoryFile : public IByteSource {
  public:
    /// Opens the file, or standard input for "-"; `count` as for TInputFile, so of compressed bytes. Errors: TClientError if it
    /// cannot be opened, is a directory or is compressed in another way; those of Read.
    explicit TInventoryFile(const std::string& path, TByteCount* count = nullptr);

    /// Errors: also TClientError if the compressed data is damaged, ends early or is followed by something else.
    std::size_t Read(char* buffer, std::size_t size) override;

    /// Reads on to the end of compressed data. Call this if the text is not an inventory: if the data is damaged, the checksum at
    /// its end shows it, and the damage is the better message. Errors: those of Read. Cost: decompresses at most 1 GiB.
    void CheckRest();

    /// What messages call the file: its path, or "standard input".
    const std::string& GetName() const { return fFile.GetName(); }

  private:
    TInputFile fFile;
    std::unique_ptr<IByteSource> fText;  // decompresses fFile; null if the file is plain
};

}  // namespace NORVZEL20

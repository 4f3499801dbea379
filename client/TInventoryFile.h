#pragma once

#include <cstddef>
#include <memory>
#include <string>

struct archive;

namespace NORVZEL20 {

/// The text of an inventory file: plain, or decompressed from gzip, xz or zstd, which its first bytes tell.
///
/// Threads: distinct files at once.
class TInventoryFile {
  public:
    /// Opens the file, or standard input for "-". Errors: TClientError where it cannot be opened or is a directory.
    explicit TInventoryFile(const std::string& path);
    TInventoryFile(const TInventoryFile&) = delete;
    TInventoryFile& operator=(const TInventoryFile&) = delete;
    ~TInventoryFile();

    /// Fills `buffer` with at most `size` bytes and returns how many there were; 0 at the end.
    /// Errors: TClientError where reading fails or the compressed data is damaged or ends early.
    std::size_t Read(char* buffer, std::size_t size);

    /// What messages call the file: its path, or "standard input".
    const std::string& GetName() const { return fName; }

  private:
    void Open(int descriptor);
    [[noreturn]] void Fail() const;

    std::string fName;
    std::unique_ptr<archive, int (*)(archive*)> fArchive;
    int fDescriptor = -1;
    bool fEmpty = false;
};

}  // namespace NORVZEL20

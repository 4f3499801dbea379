#pragma once

#include <exception>
#include <memory>
#include <string>
#include <vector>

#include "client/files/IByteSource.h"
#include "client/files/TXzEnd.h"

struct archive;

namespace NORVZEL20 {

/// The decompressed bytes of an xz or zstd file, of one stream or several in a row. Checksums in the file are verified.
class TArchiveReader : public IByteSource {
  public:
    /// `compressed` must outlive this, and begin with the magic number of `kind`, "xz" or "zstd". Messages call it `name`.
    /// Errors: those of Read.
    TArchiveReader(IByteSource& compressed, const std::string& name, const std::string& kind);
    TArchiveReader(const TArchiveReader&) = delete;
    TArchiveReader& operator=(const TArchiveReader&) = delete;
    ~TArchiveReader() override = default;

    std::size_t Read(char* buffer, std::size_t size) override;

  private:
    static long Fill(archive* reader, void* self, const void** block);
    void Open();
    [[noreturn]] void Fail() const;

    IByteSource& fCompressed;
    std::string fName;
    std::string fKind;
    std::vector<char> fBlock;
    std::exception_ptr fFault;  // thrown by fCompressed, kept until the C library has returned
    std::unique_ptr<archive, int (*)(archive*)> fArchive;
    bool fEmpty = false;
    TXzEnd fXzEnd;  // of xz data
};

}  // namespace NORVZEL20

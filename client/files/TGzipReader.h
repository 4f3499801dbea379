#pragma once

#include <zlib.h>

#include <string>
#include <vector>

#include "client/files/IByteSource.h"

namespace NORVZEL20 {

/// The decompressed bytes of a gzip file, of one member or several in a row. Checksum and length of each member are verified.
class TGzipReader : public IByteSource {
  public:
    /// `compressed` must outlive this; messages call it `name`.
    TGzipReader(IByteSource& compressed, const std::string& name);
    TGzipReader(const TGzipReader&) = delete;
    TGzipReader& operator=(const TGzipReader&) = delete;
    ~TGzipReader() override;

    std::size_t Read(char* buffer, std::size_t size) override;

  private:
    bool HasMore();
    bool Fill();
    void Inflate();

    IByteSource& fCompressed;
    std::string fName;
    std::vector<char> fBlock;
    z_stream fStream = {};
    bool fInMember = true;  // false between two members
};

}  // namespace NORVZEL20

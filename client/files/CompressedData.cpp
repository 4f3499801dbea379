// The first bytes of a file say what it is compressed with; its name does not matter, and standard input has none.
//
//   1f 8b                               gzip
//   fd 37 7a 58 5a 00                   xz
//   28 b5 2f fd                         zstd
//   BZh, 04 22 4d 18, PK 03 04, LZIP    bzip2, lz4, zip, lzip
//
// No XML document begins with any of these bytes, in any encoding that is read.
#include "client/files/CompressedData.h"

#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

const struct {
    std::string_view begin;
    const char* kind;
} kMarks[] = {
    {"\x1f\x8b", "gzip"},  {kXzMagic, "xz"}, {"\x28\xb5\x2f\xfd", "zstd"}, {"BZh", "bzip2"}, {"\x04\x22\x4d\x18", "lz4"},
    {"PK\x03\x04", "zip"}, {"LZIP", "lzip"},
};

}  // namespace

std::string RecognizeCompression(std::string_view begin)
{
    for (const auto& mark : kMarks) {
        if (begin.substr(0, mark.begin.size()) == mark.begin) {
            return mark.kind;
        }
    }
    return std::string();
}

void FailDamaged(const std::string& name, const std::string& kind, const std::string& reason)
{
    throw TClientError(name + ": cannot be read: the " + kind + " data is damaged (" + reason + "); fetch or make it anew");
}

void FailForMemory(const std::string& name)
{
    throw TClientError(name + ": cannot be read: there is not enough memory to decompress it");
}

}  // namespace NORVZEL20

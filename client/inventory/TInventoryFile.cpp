// The first bytes of an inventory file say what it is; its name does not matter, and standard input has none.
//
//   1f 8b                               gzip
//   fd 37 7a 58 5a 00                   xz
//   28 b5 2f fd                         zstd
//   BZh, 04 22 4d 18, PK 03 04, LZIP    bzip2, lz4, zip, lzip: refused, and named in the message
//   anything else                       plain; the XML parser judges it
//
// No XML document begins with any of these bytes, in any encoding that is read.
#include "client/inventory/TInventoryFile.h"

#include <vector>

#include "client/files/TArchiveReader.h"
#include "client/files/TGzipReader.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

const std::string kGzip = "\x1f\x8b";
const std::string kXz("\xfd\x37zXZ\x00", 6);
const std::string kZstd = "\x28\xb5\x2f\xfd";
const std::size_t kLongest = 6;  // of the magic numbers

const struct {
    const char* begin;
    const char* kind;
} kNotUnderstood[] = {{"BZh", "bzip2"}, {"\x04\x22\x4d\x18", "lz4"}, {"PK\x03\x04", "zip"}, {"LZIP", "lzip"}};

const std::size_t kBlockSize = 64 * 1024;
const std::size_t kMostToCheck = static_cast<std::size_t>(1) << 30;

bool BeginsWith(const std::string& text, const std::string& begin)
{
    return text.compare(0, begin.size(), begin) == 0;
}

void RefuseOthers(const std::string& begin, const std::string& name)
{
    for (const auto& other : kNotUnderstood) {
        if (BeginsWith(begin, other.begin)) {
            throw TClientError(name + ": is compressed with " + other.kind + ", which is not understood; gzip, xz and zstd are");
        }
    }
}

}  // namespace

TInventoryFile::TInventoryFile(const std::string& path) : fFile(path)
{
    const std::string& begin = fFile.Peek(kLongest);
    if (BeginsWith(begin, kGzip)) {
        fText = std::make_unique<TGzipReader>(fFile, fFile.GetName());
    } else if (BeginsWith(begin, kXz)) {
        fText = std::make_unique<TArchiveReader>(fFile, fFile.GetName(), "xz");
    } else if (BeginsWith(begin, kZstd)) {
        fText = std::make_unique<TArchiveReader>(fFile, fFile.GetName(), "zstd");
    } else {
        RefuseOthers(begin, fFile.GetName());
    }
}

std::size_t TInventoryFile::Read(char* buffer, std::size_t size)
{
    return fText ? fText->Read(buffer, size) : fFile.Read(buffer, size);
}

void TInventoryFile::CheckRest()
{
    if (!fText) {
        return;
    }
    std::vector<char> block(kBlockSize);
    for (std::size_t total = 0; total < kMostToCheck;) {
        const std::size_t count = Read(block.data(), block.size());
        if (count == 0) {
            break;
        }
        total += count;
    }
}

}  // namespace NORVZEL20

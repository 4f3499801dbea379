#include "client/inventory/TInventoryFile.h"

#include <vector>

#include "client/files/CompressedData.h"
#include "client/files/TArchiveReader.h"
#include "client/files/TGzipReader.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

const std::size_t kBlockSize = 64 * 1024;
const std::size_t kMostToCheck = static_cast<std::size_t>(1) << 30;

}  // namespace

TInventoryFile::TInventoryFile(const std::string& path, TByteCount* count) : fFile(path, count)
{
    const std::string kind = RecognizeCompression(fFile.Peek(kCompressionMark));
    if (kind == "gzip") {
        fText = std::make_unique<TGzipReader>(fFile, fFile.GetName());
    } else if (kind == "xz" || kind == "zstd") {
        fText = std::make_unique<TArchiveReader>(fFile, fFile.GetName(), kind);
    } else if (!kind.empty()) {
        throw TClientError(fFile.GetName() + ": is compressed with " + kind + ", which is not understood; gzip, xz and zstd are");
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

// An xz file is a row of streams. Each stream ends with a footer of 12 bytes:
//
//   CRC32 of the next six bytes    4 bytes, the lowest first
//   size of the index, flags       6 bytes
//   the letters YZ
//
// Behind a stream there may be zeros, four or a multiple of it, and then another stream. Compressed data can have YZ in it by
// chance, but hardly with the right checksum before it.
#include "client/files/TXzEnd.h"

#include <zlib.h>

#include <algorithm>

#include "client/files/CompressedData.h"

namespace NORVZEL20 {

namespace {

const std::size_t kFooterSize = 12;
const std::size_t kChecksumSize = 4;
const std::size_t kCheckedSize = 6;
const std::size_t kPaddingUnit = 4;
const std::size_t kMostBehind = 64 * 1024;
const std::string_view kLetters = "YZ";

bool IsFooter(std::string_view text)
{
    uLong stored = 0;
    for (std::size_t i = kChecksumSize; i > 0; --i) {
        stored = stored << 8 | static_cast<unsigned char>(text[i - 1]);
    }
    return stored == crc32(0, reinterpret_cast<const Bytef*>(text.data() + kChecksumSize), kCheckedSize);
}

}  // namespace

void TXzEnd::Watch(std::string_view piece)
{
    const std::string window = fLast.append(piece);
    if (fEnded) {
        fBehind.append(piece.substr(0, kMostBehind - std::min(kMostBehind, fBehind.size())));
    }
    for (std::size_t at = window.find(kLetters); at != std::string::npos; at = window.find(kLetters, at + 1)) {
        const std::size_t end = at + kLetters.size();
        if (end >= kFooterSize && IsFooter(std::string_view(window).substr(end - kFooterSize, kFooterSize))) {
            fEnded = true;
            fBehind = window.substr(end, kMostBehind);
        }
    }
    fLast = window.substr(window.size() - std::min(window.size(), kFooterSize - 1));
}

bool TXzEnd::HasOtherData() const
{
    const std::size_t padding = std::min(fBehind.find_first_not_of('\0'), fBehind.size());
    const std::string_view next = std::string_view(fBehind).substr(padding, kXzMagic.size());
    return fEnded && (padding % kPaddingUnit != 0 || next != kXzMagic.substr(0, next.size()));
}

}  // namespace NORVZEL20

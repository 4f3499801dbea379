#include "client/report/html/TPackedText.h"

#include <limits>
#include <new>

#include "client/report/html/Base64.h"

namespace NORVZEL20 {

namespace {

// A multiple of three, so only the last line is padded.
constexpr std::size_t kBytesOfLine = 49152;
// 16 more than the largest window makes zlib write the header of gzip.
constexpr int kGzipWindow = 15 + 16;
constexpr int kMemoryLevel = 8;

}  // namespace

TPackedText::TPackedText(const TTextSink& sink) : fSink(sink), fLine(kBytesOfLine, '\0')
{
    if (deflateInit2(&fStream, Z_DEFAULT_COMPRESSION, Z_DEFLATED, kGzipWindow, kMemoryLevel, Z_DEFAULT_STRATEGY) != Z_OK) {
        throw std::bad_alloc();
    }
}

TPackedText::~TPackedText()
{
    deflateEnd(&fStream);
}

void TPackedText::Add(std::string_view bytes)
{
    while (!bytes.empty()) {
        const std::string_view some = bytes.substr(0, std::numeric_limits<uInt>::max());
        Compress(some, Z_NO_FLUSH);
        bytes.remove_prefix(some.size());
    }
}

void TPackedText::End()
{
    Compress(std::string_view(), Z_FINISH);
    WriteLine();
}

// zlib has taken all of the bytes as soon as it leaves room in the line.
void TPackedText::Compress(std::string_view bytes, int flush)
{
    fStream.next_in = reinterpret_cast<z_const Bytef*>(const_cast<char*>(bytes.data()));
    fStream.avail_in = static_cast<uInt>(bytes.size());
    bool isFull = true;
    while (isFull) {
        fStream.next_out = reinterpret_cast<Bytef*>(&fLine[fFilled]);
        fStream.avail_out = static_cast<uInt>(kBytesOfLine - fFilled);
        deflate(&fStream, flush);
        fFilled = kBytesOfLine - fStream.avail_out;
        isFull = fFilled == kBytesOfLine;
        if (isFull) {
            WriteLine();
        }
    }
}

void TPackedText::WriteLine()
{
    if (fFilled > 0) {
        fSink(EncodeBase64(std::string_view(fLine).substr(0, fFilled)) + "\n");
        fFilled = 0;
    }
}

}  // namespace NORVZEL20

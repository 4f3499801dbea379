// A gzip file is a row of members: a header, deflated data, then the checksum and the length of the text. The texts of all members
// are one text. zlib's inflate() decodes one member and verifies its end, so this reader alternates between two states. Within a
// member the file must not end. Between members it may end or go on with another member, but with nothing else.
//
// zlib is called directly because libarchive, which reads the other kinds, does not compare the checksums of gzip.
#include "client/files/TGzipReader.h"

#include <algorithm>
#include <limits>

#include "client/files/CompressedData.h"

namespace NORVZEL20 {

namespace {

const char kKind[] = "gzip";
const std::size_t kGzipBlockSize = 64 * 1024;
const int kLargestWindow = 15;      // the logarithm to base 2
const int kGzipAlone = 16;          // added to the window: a gzip header is expected, no other
const Bytef kFirstOfMember = 0x1f;  // of the magic number

}  // namespace

TGzipReader::TGzipReader(IByteSource& compressed, const std::string& name)
    : fCompressed(compressed), fName(name), fBlock(kGzipBlockSize)
{
    if (inflateInit2(&fStream, kLargestWindow + kGzipAlone) != Z_OK) {
        FailForMemory(fName);
    }
}

TGzipReader::~TGzipReader()
{
    inflateEnd(&fStream);
}

std::size_t TGzipReader::Read(char* buffer, std::size_t size)
{
    const uInt room = static_cast<uInt>(std::min<std::size_t>(size, std::numeric_limits<uInt>::max()));
    fStream.next_out = reinterpret_cast<Bytef*>(buffer);
    fStream.avail_out = room;
    while (fStream.avail_out == room && HasMore()) {
        Inflate();
    }
    return room - fStream.avail_out;
}

// Whether there is data to inflate. Between members, prepares for the next one.
bool TGzipReader::HasMore()
{
    const bool filled = fStream.avail_in > 0 || Fill();
    if (!filled && fInMember) {
        FailDamaged(fName, kKind, "it ends early");
    }
    if (!filled || fInMember) {
        return filled;
    }
    if (*fStream.next_in != kFirstOfMember) {
        FailDamaged(fName, kKind, kSomethingFollows);
    }
    fInMember = inflateReset(&fStream) == Z_OK;
    return true;
}

bool TGzipReader::Fill()
{
    fStream.next_in = reinterpret_cast<Bytef*>(fBlock.data());
    fStream.avail_in = static_cast<uInt>(fCompressed.Read(fBlock.data(), fBlock.size()));
    return fStream.avail_in > 0;
}

void TGzipReader::Inflate()
{
    switch (inflate(&fStream, Z_NO_FLUSH)) {
    case Z_OK:
    case Z_BUF_ERROR:  // needs more data
        break;
    case Z_STREAM_END:
        fInMember = false;
        break;
    case Z_MEM_ERROR:
        FailForMemory(fName);
    default:
        FailDamaged(fName, kKind, fStream.msg == nullptr ? "unknown reason" : fStream.msg);
    }
}

}  // namespace NORVZEL20

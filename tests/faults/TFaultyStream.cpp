#include "tests/faults/TFaultyStream.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <utility>

namespace NORVZEL20 {

TFaultyStream::TFaultyStream(std::string contents, std::size_t pieceLength, std::size_t errorAt, int errors)
    : fContents(std::move(contents)), fPieceLength(pieceLength), fErrorAt(errorAt), fErrors(errors)
{}

TFaultyStream::~TFaultyStream()
{
    if (IsOpen()) {
        std::fclose(fFile);
    }
}

std::FILE* TFaultyStream::Open()
{
    const cookie_io_functions_t functions = {&Read, nullptr, nullptr, &Close};
    fFile = fopencookie(this, "r", functions);
    return fFile;
}

ssize_t TFaultyStream::Read(void* self, char* buffer, std::size_t size)
{
    auto& stream = *static_cast<TFaultyStream*>(self);
    if (stream.fPosition >= stream.fErrorAt && stream.fErrors > 0) {
        --stream.fErrors;
        errno = EIO;
        return -1;
    }
    const std::size_t end = stream.fErrors > 0 ? std::min(stream.fErrorAt, stream.fContents.size()) : stream.fContents.size();
    const std::size_t length = std::min({size, stream.fPieceLength, end - stream.fPosition});
    std::memcpy(buffer, stream.fContents.data() + stream.fPosition, length);
    stream.fPosition += length;
    return static_cast<ssize_t>(length);
}

int TFaultyStream::Close(void* self)
{
    static_cast<TFaultyStream*>(self)->fFile = nullptr;
    return 0;
}

}  // namespace NORVZEL20

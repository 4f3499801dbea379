#include "client/files/TSpooledText.h"

#include <fcntl.h>
#include <stdlib.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <new>

#include "client/files/BeginOfTemporaryFiles.h"
#include "client/process/SystemError.h"
#include "client/process/TClientError.h"
#include "client/process/TSignalsHeld.h"
#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

namespace {

const std::size_t kReadAtOnce = 65536;

// A file that is in no folder any more; not open if there can be none.
TDescriptor OpenNamelessFile() noexcept
{
    try {
        std::string path = BeginOfTemporaryFiles() + "XXXXXX";
        // A signal that ended the process in between would leave the name behind.
        const TSignalsHeld held;
        TDescriptor file(mkostemp(&path[0], O_CLOEXEC));
        if (file) {
            unlink(path.c_str());
        }
        return file;
    } catch (const std::bad_alloc&) {
        return TDescriptor();
    }
}

}  // namespace

void TSpooledText::Append(std::string_view piece)
{
    if (fTail.size() + piece.size() > kMostInMemory && !fIsFileClosed) {
        MoveToFile();
    }
    fTail += piece;
}

void TSpooledText::MoveToFile() noexcept
{
    if (!fFile) {
        fFile = OpenNamelessFile();
    }
    if (!fFile || TryWriteWhole(fFile.Get(), fTail)) {
        fIsFileClosed = true;
        return;
    }
    fInFile += fTail.size();
    fTail.clear();
}

void TSpooledText::ForEachPiece(const TCallback& callback) const
{
    ReadFile(callback);
    if (!fTail.empty()) {
        callback(fTail);
    }
}

void TSpooledText::ReadFile(const TCallback& callback) const
{
    std::array<char, kReadAtOnce> buffer;
    for (std::uint64_t at = 0; at < fInFile;) {
        const std::size_t count = ReadFileAt(at, buffer.data(), buffer.size());
        callback(std::string_view(buffer.data(), count));
        at += count;
    }
}

std::size_t TSpooledText::ReadAt(std::uint64_t place, char* buffer, std::size_t size) const
{
    if (place < fInFile && size > 0) {
        return ReadFileAt(place, buffer, size);
    }
    const std::uint64_t inTail = place - fInFile;
    return inTail < fTail.size() ? fTail.copy(buffer, size, static_cast<std::size_t>(inTail)) : 0;
}

// `place` is in the file. At least one byte.
std::size_t TSpooledText::ReadFileAt(std::uint64_t place, char* buffer, std::size_t size) const
{
    const std::size_t most = static_cast<std::size_t>(std::min<std::uint64_t>(size, fInFile - place));
    for (;;) {
        const ssize_t count = pread(fFile.Get(), buffer, most, static_cast<off_t>(place));
        if (count > 0) {
            return static_cast<std::size_t>(count);
        }
        const std::error_code reason = count == 0 ? std::make_error_code(std::errc::io_error) : LastSystemError();
        if (reason != std::errc::interrupted) {
            throw TClientError("the temporary file of the result cannot be read", reason);
        }
    }
}

}  // namespace NORVZEL20

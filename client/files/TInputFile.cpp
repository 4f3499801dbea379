// Reading without buffers of the C library: descriptors are read in the pieces that the decompressor or the parser asks for, and
// every error of read() is seen. The program may be started with a standard input that does not block; then poll() waits.
#include "client/files/TInputFile.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>

#include "client/process/StandardDescriptors.h"
#include "client/process/SystemError.h"
#include "client/process/TClientError.h"
#include "client/process/TDescriptor.h"

namespace NORVZEL20 {

namespace {

int OpenFile(const std::string& path)
{
    if (path == "-") {
        if (IsClosed(STDIN_FILENO)) {
            throw TClientError("standard input: cannot be read: it is closed");
        }
        return STDIN_FILENO;
    }
    TDescriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC));
    if (!file) {
        const std::error_code reason = LastSystemError();
        throw TClientError(path + ": cannot be opened", reason);
    }
    // A directory can be opened, but not read; saying so now makes the better message.
    struct stat status;
    if (fstat(file.Get(), &status) == 0 && S_ISDIR(status.st_mode)) {
        throw TClientError(path + ": is a directory; name an inventory file, or - for standard input");
    }
    return file.Release();
}

}  // namespace

std::string NameOfInput(const std::string& path)
{
    return path == "-" ? "standard input" : path;
}

TInputFile::TInputFile(const std::string& path, TByteCount* count)
    : fName(NameOfInput(path)), fDescriptor(OpenFile(path)), fCount(count)
{}

TInputFile::~TInputFile()
{
    // Standard input belongs to the process.
    if (fDescriptor != STDIN_FILENO) {
        close(fDescriptor);
    }
}

const std::string& TInputFile::Peek(std::size_t count)
{
    // One read is not enough: a pipe may deliver less than asked for, and more later.
    fPeeked.resize(count);
    std::size_t length = 0;
    while (length < count) {
        const std::size_t piece = ReadDescriptor(&fPeeked[length], count - length);
        if (piece == 0) {
            break;
        }
        length += piece;
    }
    fPeeked.resize(length);
    return fPeeked;
}

std::size_t TInputFile::Read(char* buffer, std::size_t size)
{
    if (fDelivered == fPeeked.size()) {
        return ReadDescriptor(buffer, size);
    }
    const std::size_t count = fPeeked.copy(buffer, size, fDelivered);
    fDelivered += count;
    return count;
}

std::size_t TInputFile::ReadDescriptor(char* buffer, std::size_t size)
{
    for (;;) {
        const ssize_t count = read(fDescriptor, buffer, size);
        if (count >= 0) {
            if (fCount != nullptr) {
                fCount->fetch_add(static_cast<std::uint64_t>(count), std::memory_order_relaxed);
            }
            return static_cast<std::size_t>(count);
        }
        const std::error_code reason = LastSystemError();
        if (reason == std::errc::resource_unavailable_try_again) {
            pollfd wait = {fDescriptor, POLLIN, 0};
            // Waits without using the processor; errors show at the next read().
            poll(&wait, 1, -1);
        } else if (reason != std::errc::interrupted) {
            throw TClientError(fName + ": cannot be read", reason);
        }
    }
}

void RequireOneStandardInput(const std::vector<std::string>& paths)
{
    if (std::count(paths.begin(), paths.end(), "-") > 1) {
        throw TClientError("standard input (-) can be read only once; save it to a file first");
    }
}

}  // namespace NORVZEL20

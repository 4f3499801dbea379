#include "client/files/TInputFile.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "client/process/StandardDescriptors.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

int OpenFile(const std::string& path)
{
    if (path == "-") {
        return STDIN_FILENO;
    }
    const int descriptor = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (descriptor < 0) {
        throw TClientError(path + ": cannot be opened: " + std::strerror(errno));
    }
    struct stat status;
    if (fstat(descriptor, &status) == 0 && S_ISDIR(status.st_mode)) {
        close(descriptor);
        throw TClientError(path + ": is a directory; name an inventory file, or - for standard input");
    }
    return descriptor;
}

}  // namespace

TInputFile::TInputFile(const std::string& path) : fName(path == "-" ? "standard input" : path), fDescriptor(OpenFile(path)) {}

TInputFile::~TInputFile()
{
    if (fDescriptor != STDIN_FILENO) {
        close(fDescriptor);
    }
}

const std::string& TInputFile::Peek(std::size_t count)
{
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
            return static_cast<std::size_t>(count);
        }
        if (errno == EAGAIN) {
            pollfd wait = {fDescriptor, POLLIN, 0};
            poll(&wait, 1, -1);
        } else if (errno == EBADF && IsClosed(fDescriptor)) {
            throw TClientError(fName + ": cannot be read: it is closed");
        } else if (errno != EINTR) {
            throw TClientError(fName + ": cannot be read: " + std::strerror(errno));
        }
    }
}

}  // namespace NORVZEL20

#include "client/ResultOutput.h"

#include <fcntl.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>

#include "client/TClientError.h"
#include "client/WholeWrite.h"

namespace NORVZEL20 {

namespace {

[[noreturn]] void Fail(const std::string& path, int error)
{
    throw TClientError(path + ": cannot be written: " + std::strerror(error));
}

// The rights of the file that is replaced, else those that a file made in the ordinary way would have; mkstemp gives fewer.
mode_t ModeFor(const std::string& path)
{
    struct stat status;
    if (stat(path.c_str(), &status) == 0) {
        return status.st_mode & 0777;
    }
    const mode_t mask = umask(0);
    umask(mask);
    return 0666 & ~mask;
}

// A device or a pipe is written to, not replaced.
bool IsSpecial(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode);
}

void WriteSpecial(const std::string& path, const std::string& text)
{
    const int descriptor = open(path.c_str(), O_WRONLY | O_CLOEXEC);
    if (descriptor < 0) {
        Fail(path, errno);
    }
    const int error = WriteWhole(descriptor, text);
    close(descriptor);
    if (error != 0) {
        Fail(path, error);
    }
}

// Where a link leads, so that the link stays.
std::string Resolve(const std::string& path)
{
    char* real = realpath(path.c_str(), nullptr);
    const std::string resolved = real == nullptr ? path : real;
    free(real);
    return resolved;
}

int WriteAndSync(int descriptor, const std::string& text, mode_t mode)
{
    int error = WriteWhole(descriptor, text);
    if (error == 0 && (fchmod(descriptor, mode) != 0 || fsync(descriptor) != 0)) {
        error = errno;
    }
    return close(descriptor) != 0 && error == 0 ? errno : error;
}

void WriteFile(const std::string& path, const std::string& text)
{
    const std::string target = Resolve(path);
    std::string beside = target + ".XXXXXX";
    const int descriptor = mkstemp(&beside[0]);
    if (descriptor < 0) {
        Fail(path, errno);
    }
    int error = WriteAndSync(descriptor, text, ModeFor(target));
    if (error == 0 && std::rename(beside.c_str(), target.c_str()) != 0) {
        error = errno;
    }
    if (error != 0) {
        unlink(beside.c_str());
        Fail(path, error);
    }
}

}  // namespace

void DeliverResult(IConsole& console, const std::string& path, const std::string& text)
{
    if (path.empty()) {
        console.WriteResult(text);
    } else if (IsSpecial(path)) {
        WriteSpecial(path, text);
    } else {
        WriteFile(path, text);
    }
}

}  // namespace NORVZEL20

#include "client/report/ResultOutput.h"

#include <fcntl.h>
#include <limits.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "client/files/TUnfinishedFile.h"
#include "client/process/TClientError.h"
#include "client/process/WholeWrite.h"

namespace NORVZEL20 {

namespace {

const int kMostLinks = 40;
const int kNone = -1;

[[noreturn]] void Fail(const std::string& path, int error)
{
    throw TClientError(path + ": cannot be written: " + std::strerror(error));
}

// The folder of a path, with the slash behind it; empty for the current one.
std::string FolderOf(const std::string& path)
{
    return path.substr(0, path.rfind('/') + 1);
}

std::string RealPath(const std::string& path)
{
    char real[PATH_MAX];
    return realpath(path.c_str(), real) == nullptr ? std::string() : real;
}

// The descriptor of this process that a path such as /dev/stdout leads to, by its name below /proc/self/fd; else kNone.
int DescriptorNamed(const std::string& path)
{
    const std::string folder = RealPath("/proc/self/fd");
    if (folder.empty() || RealPath(FolderOf(path)) != folder) {
        return kNone;
    }
    return atoi(path.c_str() + FolderOf(path).size());
}

// Where a path leads.
struct TTarget {
    std::string path;  ///< at the end of all links, whether there is a file or not, so that the links stay
    int descriptor;    ///< of this process, else kNone
};

TTarget FollowLinks(const std::string& path)
{
    TTarget target = {path, kNone};
    char link[PATH_MAX];
    for (int links = 0; links < kMostLinks; ++links) {
        const ssize_t length = readlink(target.path.c_str(), link, sizeof link);
        if (length < 0) {
            return target;
        }
        target.descriptor = DescriptorNamed(target.path);
        if (target.descriptor != kNone) {
            return target;
        }
        const std::string next(link, static_cast<std::size_t>(length));
        target.path = next[0] == '/' ? next : FolderOf(target.path) + next;
    }
    Fail(path, ELOOP);
}

// A device or a pipe is written to, not replaced.
bool IsSpecial(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode);
}

// A reader that is gone needs to be told nothing.
void CheckWritten(const std::string& path, int error)
{
    if (error == EPIPE) {
        throw TClientError("");
    }
    if (error != 0) {
        Fail(path, error);
    }
}

void WriteSpecial(const std::string& path, const std::string& text)
{
    const int descriptor = open(path.c_str(), O_WRONLY | O_CLOEXEC);
    if (descriptor < 0) {
        Fail(path, errno);
    }
    const int error = WriteWhole(descriptor, text);
    const int closing = close(descriptor) != 0 ? errno : 0;
    CheckWritten(path, error != 0 ? error : closing);
}

// Gives the file the owner and the rights of the one that it replaces, else the rights that a file made in the ordinary way would
// have; a temporary one has fewer. Returns 0 or errno.
int SetRights(int descriptor, const std::string& target)
{
    struct stat status;
    mode_t mode = 0;
    if (stat(target.c_str(), &status) == 0) {
        // Only root may give a file away; anybody else who replaces another one's file owns the new one.
        static_cast<void>(fchown(descriptor, status.st_uid, status.st_gid) == 0);
        mode = status.st_mode & 0777;
    } else {
        const mode_t mask = umask(0);
        umask(mask);
        mode = 0666 & ~mask;
    }
    return fchmod(descriptor, mode) != 0 ? errno : 0;
}

int WriteAndSync(TUnfinishedFile& file, const std::string& text, const std::string& target)
{
    int error = WriteWhole(file.GetDescriptor(), text);
    if (error == 0) {
        error = SetRights(file.GetDescriptor(), target);
    }
    if (error != 0) {
        return error;
    }
    if (fsync(file.GetDescriptor()) != 0) {
        return errno;
    }
    return file.Close();
}

void WriteFile(const std::string& path, const std::string& target, const std::string& text)
{
    // The name's length has nothing to do with the final one's, which may be as long as names can be.
    TUnfinishedFile file(FolderOf(target) + ".cimdelta-");
    int error = file.GetError();
    if (error == 0) {
        error = WriteAndSync(file, text, target);
    }
    if (error == 0) {
        error = file.MoveTo(target);
    }
    if (error != 0) {
        Fail(path, error);
    }
}

}  // namespace

bool IsStandardOutput(const std::string& path)
{
    return path.empty() || path == "-";
}

void DeliverResult(IConsole& console, const std::string& path, const std::string& text)
{
    if (IsStandardOutput(path)) {
        console.WriteResult(text);
        return;
    }
    const TTarget target = FollowLinks(path);
    if (target.descriptor != kNone) {
        CheckWritten(path, WriteWhole(target.descriptor, text));
    } else if (IsSpecial(path)) {
        WriteSpecial(path, text);
    } else {
        WriteFile(path, target.path, text);
    }
}

}  // namespace NORVZEL20

// How a result reaches the place that the person named with --output.
//
// A path can lead to three kinds of places. Links are followed by hand, one at a time, because the last one may lead to a file
// that does not exist yet, and because a link below /proc/self/fd (/dev/stdout is one) stands for an open descriptor:
//   an open descriptor    is written to as it is; the shell's >> still appends;
//   a device or a pipe    is opened and written to;
//   an ordinary file      is replaced: the text goes to a temporary file in the same folder (a rename cannot leave its file
//                         system), which gets the old file's owner and rights, is synced, and takes the name over by rename().
// A path whose name asks for it gets its text compressed, whatever it leads to.
//
// A failure, or the end of the process, before the rename leaves the old file as it was. Descriptors, devices and pipes get nothing
// before the result is complete, and neither does standard output: their text waits in a TSpooledText.
#include "client/report/TResultOutput.h"

#include <fcntl.h>
#include <limits.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <unistd.h>

#include <utility>

#include "client/files/TFileIdentity.h"
#include "client/process/SystemError.h"
#include "client/process/TClientError.h"
#include "client/process/TDescriptor.h"
#include "client/process/TReaderGone.h"
#include "client/process/WriteWhole.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

// Linux follows as many links in one path.
const int kMostLinks = 40;

const std::size_t kWrittenAtOnce = 65536;

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

// The descriptor of this process that a path such as /proc/self/fd/1 stands for, open or not, if it is one of those paths.
std::optional<int> DescriptorNamed(const std::string& path)
{
    const std::string folder = RealPath("/proc/self/fd");
    if (folder.empty() || RealPath(FolderOf(path)) != folder) {
        return std::nullopt;
    }
    const std::optional<std::uint64_t> number = NumberIn(std::string_view{path}.substr(FolderOf(path).size()));
    return number && *number <= INT_MAX ? std::optional<int>(static_cast<int>(*number)) : std::nullopt;
}

// The end of a path.
struct TTarget {
    std::string path;               ///< at the end of all links, whether or not there is a file
    std::optional<int> descriptor;  ///< the descriptor that it stands for, if it does
};

TTarget FollowLinks(const std::string& path)
{
    TTarget target = {path, std::nullopt};
    char link[PATH_MAX];
    for (int links = 0; links < kMostLinks; ++links) {
        target.descriptor = DescriptorNamed(target.path);
        const ssize_t length = readlink(target.path.c_str(), link, sizeof link);
        if (target.descriptor || length < 0) {
            return target;
        }
        const std::string next(link, static_cast<std::size_t>(length));
        target.path = next[0] == '/' ? next : FolderOf(target.path) + next;
    }
    throw std::system_error(ELOOP, std::generic_category());
}

// Whether the path names something that is written to rather than replaced: a device or a pipe.
bool IsSpecial(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode);
}

// Where the entry of a file stands: its folder, by whatever path, and its name there.
bool AreSameEntry(const std::string& a, const std::string& b)
{
    const auto folder = [](const std::string& path) { return IdentifyFile(FolderOf(path).empty() ? "." : FolderOf(path)); };
    const std::optional<TFileIdentity> first = folder(a);
    const std::optional<TFileIdentity> second = folder(b);
    return first && second && *first == *second && a.substr(FolderOf(a).size()) == b.substr(FolderOf(b).size());
}

// Gives the file the owner and the rights of the one that it replaces. If there is none, gives it the rights that any new file
// would have: a temporary file has fewer.
void SetRights(int descriptor, const std::string& target)
{
    struct stat status;
    mode_t mode = 0;
    if (stat(target.c_str(), &status) == 0) {
        // Only root may give a file away. If anybody else replaces another user's file, the new one is theirs.
        static_cast<void>(fchown(descriptor, status.st_uid, status.st_gid) == 0);
        mode = status.st_mode & 0777;
    } else {
        // The mask cannot be read without setting it.
        const mode_t mask = umask(0);
        umask(mask);
        mode = 0666 & ~mask;
    }
    ThrowIfFailed(fchmod(descriptor, mode));
}

void CheckAccess(const std::string& path, int mode)
{
    ThrowIfFailed(faccessat(AT_FDCWD, path.c_str(), mode, AT_EACCESS));
}

// A new file needs a name that its folder takes, and the right to write to the folder.
void CheckReplacement(const std::string& target)
{
    struct stat status;
    if (stat(target.c_str(), &status) != 0 && errno != ENOENT) {
        throw std::system_error(LastSystemError());
    }
    const std::string folder = FolderOf(target);
    CheckAccess(folder.empty() ? "." : folder, W_OK | X_OK);
}

void CheckDescriptor(int descriptor)
{
    const int flags = fcntl(descriptor, F_GETFL);
    ThrowIfFailed(flags);
    if ((flags & O_ACCMODE) == O_RDONLY) {
        throw std::system_error(EBADF, std::generic_category());
    }
}

void CheckSpecial(const std::string& path)
{
    struct stat status;
    if (stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode)) {
        throw std::system_error(EISDIR, std::generic_category());
    }
    CheckAccess(path, W_OK);
}

void CheckTarget(const std::string& path)
{
    const TTarget target = FollowLinks(path);
    if (target.descriptor) {
        CheckDescriptor(*target.descriptor);
    } else if (IsSpecial(path)) {
        CheckSpecial(path);
    } else {
        CheckReplacement(target.path);
    }
}

// A device, such as /dev/null, or a terminal can be read and written.
void CheckNotRead(const std::string& path, const std::vector<std::string>& inputs)
{
    const std::optional<TFileIdentity> output = IdentifyFile(path);
    if (!output || IsSpecial(path)) {
        return;
    }
    for (const std::string& input : inputs) {
        const std::optional<TFileIdentity> identity = IdentifyFile(input);
        if (identity && *identity == *output) {
            throw TClientError(path + ": is one of the files that are read; name another file for the result");
        }
    }
}

// What a failed call says about the result.
[[noreturn]] void RefuseToWrite(const std::string& path, const std::system_error& error)
{
    if (error.code() == std::errc::broken_pipe) {
        throw TReaderGone();
    }
    throw TClientError(path + ": cannot be written", error.code());
}

TTarget FindTarget(const std::string& path)
{
    try {
        return FollowLinks(IsStandardOutput(path) ? "/dev/stdout" : path);
    } catch (const std::system_error& error) {
        RefuseToWrite(path, error);
    }
}

}  // namespace

bool IsStandardOutput(const std::string& path)
{
    return path.empty() || path == "-";
}

bool AreSameTarget(const std::string& a, const std::string& b)
{
    const TTarget first = FindTarget(a);
    const TTarget second = FindTarget(b);
    if ((first.descriptor && second.descriptor) || IsSpecial(first.path) || IsSpecial(second.path)) {
        return false;
    }
    if (!first.descriptor && !second.descriptor) {
        return AreSameEntry(first.path, second.path);
    }
    const std::optional<TFileIdentity> one = IdentifyFile(first.path);
    const std::optional<TFileIdentity> other = IdentifyFile(second.path);
    return one && other && *one == *other;
}

void CheckOutput(const std::string& path, const std::vector<std::string>& inputs)
{
    if (IsStandardOutput(path)) {
        return;
    }
    CompressionOfName(path);
    try {
        CheckTarget(path);
        CheckNotRead(path, inputs);
    } catch (const std::system_error& error) {
        RefuseToWrite(path, error);
    }
}

void CheckPlainOutput(const std::string& path, const std::vector<std::string>& inputs)
{
    CheckOutput(path, inputs);
    if (const std::string kind = CompressionOfName(path); !kind.empty()) {
        throw TClientError(path + ": found a name for " + kind +
                           ", but rules and accepted differences are kept as plain text; give the file another name");
    }
}

TResultOutput::TResultOutput(IConsole& console, std::string path) : fConsole(console), fPath(std::move(path))
{
    if (IsStandardOutput(fPath)) {
        return;
    }
    const std::string kind = CompressionOfName(fPath);
    try {
        const TTarget target = FollowLinks(fPath);
        fTarget = target.path;
        fDescriptor = target.descriptor;
        if (!fDescriptor && !IsSpecial(fPath)) {
            // A short name of its own: the final name may be as long as names can be and leave no room for a suffix.
            fFile = std::make_unique<TUnfinishedFile>(FolderOf(fTarget) + ".cimdelta-");
        }
    } catch (const std::system_error& error) {
        RefuseToWrite(fPath, error);
    }
    // Last, since it may write at once.
    if (!kind.empty()) {
        fCompressor = std::make_unique<TCompressor>(kind, [this](std::string_view piece) { Keep(piece); });
    }
}

void TResultOutput::Write(std::string_view piece)
{
    if (fCompressor) {
        fCompressor->Write(piece);
    } else {
        Keep(piece);
    }
}

void TResultOutput::Keep(std::string_view piece)
{
    if (!fFile) {
        fText.Append(piece);
        return;
    }
    if (fPiece.size() + piece.size() > kWrittenAtOnce) {
        WriteToFile();
    }
    fPiece += piece;
}

void TResultOutput::WriteToFile()
{
    try {
        WriteWhole(fFile->GetDescriptor(), fPiece);
    } catch (const std::system_error& error) {
        RefuseToWrite(fPath, error);
    }
    fPiece.clear();
}

void TResultOutput::Deliver(std::string_view end)
{
    if (fCompressor) {
        fCompressor->Write(end);
        fCompressor->End();
        end = std::string_view();
    }
    try {
        if (IsStandardOutput(fPath)) {
            ForEachPiece(end, [this](std::string_view piece) { fConsole.WriteResult(piece); });
        } else if (fFile) {
            ReplaceFile(end);
        } else if (fDescriptor) {
            WriteTo(*fDescriptor, end);
        } else {
            WriteSpecial(end);
        }
    } catch (const std::system_error& error) {
        RefuseToWrite(fPath, error);
    }
}

void TResultOutput::ForEachPiece(std::string_view end, const TSpooledText::TCallback& callback) const
{
    fText.ForEachPiece(callback);
    callback(end);
}

void TResultOutput::WriteTo(int descriptor, std::string_view end) const
{
    ForEachPiece(end, [descriptor](std::string_view piece) { WriteWhole(descriptor, piece); });
}

void TResultOutput::WriteSpecial(std::string_view end) const
{
    TDescriptor file(open(fPath.c_str(), O_WRONLY | O_CLOEXEC));
    ThrowIfFailed(file.Get());
    WriteTo(file.Get(), end);
    ThrowIfFailed(close(file.Release()));
}

void TResultOutput::ReplaceFile(std::string_view end)
{
    WriteToFile();
    WriteWhole(fFile->GetDescriptor(), end);
    SetRights(fFile->GetDescriptor(), fTarget);
    ThrowIfFailed(fsync(fFile->GetDescriptor()));
    fFile->Close();
    fFile->MoveTo(fTarget);
}

void DeliverResult(IConsole& console, const std::string& path, std::string_view text)
{
    TResultOutput(console, path).Deliver(text);
}

}  // namespace NORVZEL20

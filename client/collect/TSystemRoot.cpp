// How the files of a system are reached.
//
// A path of the running system is opened as it is. In a copy, the kernel resolves each path as if the folder were "/" (openat2 with
// RESOLVE_IN_ROOT): neither ".." nor a link leads out. Before a file is opened for reading, it is looked at through a descriptor
// that opens nothing (O_PATH): a pipe without a writer would wait, and some devices act when they are opened. It is then opened by
// its name, without waiting, and looked at again, because another file may have the name by then.
#include "client/collect/TSystemRoot.h"

#include <dirent.h>
#include <fcntl.h>
#include <linux/openat2.h>
#include <sys/syscall.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <memory>
#include <system_error>

#include "client/process/SystemError.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kReadAtOnce = 64U << 10U;

bool IsOrdinary(int descriptor, std::string& trouble)
{
    struct stat status;
    if (fstat(descriptor, &status) != 0) {
        trouble = TSystemRoot::TroubleOf(errno);
        return false;
    }
    if (!S_ISREG(status.st_mode)) {
        trouble = "it is no ordinary file";
        return false;
    }
    return true;
}

TFolderEntry::EKind KindOf(const dirent& entry, int folder)
{
    unsigned char type = entry.d_type;
    struct stat status;
    if (type == DT_UNKNOWN && fstatat(folder, entry.d_name, &status, AT_SYMLINK_NOFOLLOW) == 0) {
        type = static_cast<unsigned char>(IFTODT(status.st_mode));
    }
    switch (type) {
    case DT_REG:
        return TFolderEntry::EKind::kFile;
    case DT_DIR:
        return TFolderEntry::EKind::kFolder;
    case DT_LNK:
        return TFolderEntry::EKind::kLink;
    default:
        return TFolderEntry::EKind::kOther;
    }
}

// At the end of the folder errno is 0, after an error it is not.
const dirent* NextEntry(DIR* folder)
{
    errno = 0;
    return readdir(folder);
}

bool IsOwnOrParent(const std::string& name)
{
    return name == "." || name == "..";
}

// Appends what can be read. Returns false, with the reason, on failure and if it is more than `mostBytes`.
bool ReadAll(int descriptor, std::size_t mostBytes, std::string& text, std::string& trouble)
{
    while (text.size() <= mostBytes) {
        const std::size_t had = text.size();
        text.resize(had + kReadAtOnce);
        const ssize_t got = read(descriptor, &text[had], kReadAtOnce);
        text.resize(had + static_cast<std::size_t>(std::max<ssize_t>(got, 0)));
        if (got == 0) {
            return true;
        }
        if (got < 0 && errno != EINTR) {
            trouble = TSystemRoot::TroubleOf(errno);
            return false;
        }
    }
    trouble = "it has more than " + std::to_string(mostBytes >> 20U) + " MiB";
    return false;
}

}  // namespace

TSystemRoot::TSystemRoot(const std::string& path)
    : fRoot(open(path.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)), fIsRunning(path == "/")
{
    if (!fRoot) {
        throw TClientError(path + ": cannot be opened", LastSystemError());
    }
}

std::string TSystemRoot::TroubleOf(int error)
{
    if ((error == EACCES || error == EPERM) && geteuid() != 0) {
        return "not everybody may read it";
    }
    return std::generic_category().message(error);
}

TDescriptor TSystemRoot::Open(const std::string& path, int flags) const
{
    if (fIsRunning) {
        return TDescriptor(open(path.c_str(), flags | O_CLOEXEC));
    }
    open_how how{};
    how.flags = static_cast<std::uint64_t>(flags | O_CLOEXEC);
    how.resolve = RESOLVE_IN_ROOT;
    return TDescriptor(static_cast<int>(syscall(SYS_openat2, fRoot.Get(), path.c_str(), &how, sizeof how)));
}

TDescriptor TSystemRoot::OpenPlace(const std::string& path) const
{
    return Open(path, O_PATH);
}

TDescriptor TSystemRoot::OpenFile(const std::string& path, std::string& trouble) const
{
    const TDescriptor place = Open(path, O_PATH | O_NOFOLLOW);
    if (!place) {
        trouble = TroubleOf(errno);
        return TDescriptor();
    }
    if (!IsOrdinary(place.Get(), trouble)) {
        return TDescriptor();
    }
    TDescriptor file = Open(path, O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY);
    if (!file) {
        trouble = TroubleOf(errno);
        return TDescriptor();
    }
    return IsOrdinary(file.Get(), trouble) ? std::move(file) : TDescriptor();
}

TFileText TSystemRoot::Read(const std::string& path, std::size_t mostBytes) const
{
    TFileText result;
    const TDescriptor place = Open(path, O_PATH);
    if (!place) {
        result.isMissing = errno == ENOENT || errno == ENOTDIR;
        result.trouble = TroubleOf(errno);
        return result;
    }
    if (!IsOrdinary(place.Get(), result.trouble)) {
        return result;
    }
    const TDescriptor file = Open(path, O_RDONLY | O_NONBLOCK | O_NOCTTY);
    if (!file) {
        result.trouble = TroubleOf(errno);
        return result;
    }
    if (!IsOrdinary(file.Get(), result.trouble) || !ReadAll(file.Get(), mostBytes, result.text, result.trouble)) {
        result.text.clear();
    }
    return result;
}

std::vector<TFolderEntry> TSystemRoot::List(const std::string& path, std::string& trouble) const
{
    std::vector<TFolderEntry> entries;
    TDescriptor descriptor = Open(path, O_RDONLY | O_DIRECTORY | O_NONBLOCK);
    const std::unique_ptr<DIR, int (*)(DIR*)> folder(descriptor ? fdopendir(descriptor.Get()) : nullptr, &closedir);
    if (!folder) {
        trouble = errno == ENOENT ? std::string() : TroubleOf(errno);
        return entries;
    }
    const int number = descriptor.Release();  // the folder closes it
    while (const dirent* entry = NextEntry(folder.get())) {
        if (entries.size() == kMostEntries) {
            trouble = "it has more than " + std::to_string(kMostEntries) + " names";
            return {};
        }
        if (!IsOwnOrParent(entry->d_name)) {
            entries.push_back({entry->d_name, KindOf(*entry, number)});
        }
    }
    if (errno != 0) {
        trouble = TroubleOf(errno);
        return {};
    }
    std::sort(entries.begin(), entries.end(), [](const TFolderEntry& a, const TFolderEntry& b) { return a.name < b.name; });
    return entries;
}

std::vector<TFolderEntry> TSystemRoot::List(const std::string& path) const
{
    std::string ignored;
    return List(path, ignored);
}

std::optional<std::string> TSystemRoot::ReadLink(const std::string& path) const
{
    const TDescriptor place = Open(path, O_PATH | O_NOFOLLOW);
    char target[PATH_MAX];
    const ssize_t length = place ? readlinkat(place.Get(), "", target, sizeof target) : -1;
    return length < 0 ? std::nullopt : std::optional<std::string>(std::string(target, static_cast<std::size_t>(length)));
}

std::optional<struct stat> TSystemRoot::Look(const std::string& path) const
{
    const TDescriptor place = Open(path, O_PATH | O_NOFOLLOW);
    struct stat status;
    return place && fstat(place.Get(), &status) == 0 ? std::optional<struct stat>(status) : std::nullopt;
}

}  // namespace NORVZEL20

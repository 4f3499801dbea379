// Which files a document may include.
//
// A document names files, and it may come from anywhere. So a name counts only if its file, with all links and ".." resolved, is
// within one of the folders that the caller named. The resolved path is the file's identity. It is opened one folder after the
// other without following links: if somebody puts a link there between the two steps, opening fails.
#include "embedded/mof/TMofFolders.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <memory>

namespace NORVZEL20 {

namespace {

/// The path without links and ".."; empty if there is nothing.
std::string Resolve(const std::string& path)
{
    const std::unique_ptr<char, void (*)(void*)> resolved(realpath(path.c_str(), nullptr), &std::free);
    return resolved ? std::string(resolved.get()) : std::string();
}

/// The folder that the file is in, with a slash at its end; empty for the present one.
std::string GetFolder(const std::string& file)
{
    const std::size_t slash = file.rfind('/');
    return slash == std::string::npos ? std::string() : file.substr(0, slash + 1);
}

/// A descriptor that is closed at the end.
class TDescriptor {
  public:
    explicit TDescriptor(int number) noexcept : fNumber(number) {}
    TDescriptor(const TDescriptor&) = delete;
    TDescriptor& operator=(const TDescriptor&) = delete;
    ~TDescriptor() { Set(-1); }

    int Get() const noexcept { return fNumber; }
    void Set(int number) noexcept
    {
        if (fNumber >= 0) {
            close(fNumber);
        }
        fNumber = number;
    }

  private:
    int fNumber;
};

/// Opens an absolute path in which no part may be a link; negative if that fails.
void OpenWithoutLinks(const std::string& path, TDescriptor& descriptor)
{
    descriptor.Set(open("/", O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    for (std::size_t begin = 1; descriptor.Get() >= 0 && begin < path.size();) {
        const std::size_t slash = std::min(path.find('/', begin), path.size());
        const int kind = slash < path.size() ? O_DIRECTORY : O_NONBLOCK;
        descriptor.Set(
            openat(descriptor.Get(), path.substr(begin, slash - begin).c_str(), O_RDONLY | O_NOFOLLOW | O_CLOEXEC | kind));
        begin = slash + 1;
    }
}

}  // namespace

void TMofFolders::Add(const std::string& folder)
{
    std::string root = Resolve(folder.empty() ? "." : folder);
    if (root.empty()) {
        return;
    }
    root += root.back() == '/' ? "" : "/";
    if (std::find(fRoots.begin(), fRoots.end(), root) == fRoots.end()) {
        fFolders.push_back(folder.empty() || folder.back() == '/' ? folder : folder + '/');
        fRoots.push_back(root);
    }
}

bool TMofFolders::Contains(const std::string& path) const
{
    return std::any_of(fRoots.begin(), fRoots.end(),
                       [&](const std::string& root) { return path.compare(0, root.size(), root) == 0; });
}

bool TMofFolders::Find(const std::string& name, const std::string& from, TFile& file, std::string& reason)
{
    std::string plain = name;
    std::replace(plain.begin(), plain.end(), '\\', '/');
    std::vector<std::string> tried{GetFolder(from)};
    tried.insert(tried.end(), fFolders.begin(), fFolders.end());
    const bool isBadName = plain.empty() || plain.front() == '/';
    bool isOutside = isBadName;
    for (std::size_t index = 0; index < tried.size() && !isBadName; ++index) {
        file.name = tried[index] + plain;
        file.identity = Resolve(file.name);
        if (Contains(file.identity)) {
            return true;
        }
        isOutside = isOutside || !file.identity.empty();
    }
    reason = fFolders.empty() ? "but no folders are given for included files; give the folder that it is in"
             : isOutside      ? "which is outside of the folders given for included files; put it into one of them"
                              : "which is not there; put it into one of the folders given for included files";
    return false;
}

bool TMofFolders::Read(const TFile& file, std::size_t most, std::string& bytes, std::string& reason)
{
    TDescriptor descriptor(-1);
    OpenWithoutLinks(file.identity, descriptor);
    struct stat about {};
    if (descriptor.Get() < 0 || fstat(descriptor.Get(), &about) != 0) {
        reason = std::string("which cannot be opened: ") + std::strerror(errno);
        return false;
    }
    if (!S_ISREG(about.st_mode)) {
        reason = "which is no file";
        return false;
    }
    bytes.clear();
    char piece[64 * 1024];
    for (ssize_t length = 1; length > 0;) {
        length = read(descriptor.Get(), piece, sizeof piece);
        if (length < 0) {
            reason = std::string("which cannot be read: ") + std::strerror(errno);
            return false;
        }
        bytes.append(piece, static_cast<std::size_t>(length));
        if (bytes.size() > most) {
            reason = "which has more than " + std::to_string(most) + " bytes; split it";
            return false;
        }
    }
    return true;
}

}  // namespace NORVZEL20

#include "client/files/TAnonymousFile.h"

#include <fcntl.h>
#include <sys/mman.h>

#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

namespace {

bool CanBeOpened(const std::string& path)
{
    return static_cast<bool>(TDescriptor(open(path.c_str(), O_RDONLY | O_CLOEXEC)));
}

}  // namespace

std::unique_ptr<TAnonymousFile> TAnonymousFile::TryMake(const std::string& content)
{
    std::unique_ptr<TAnonymousFile> file(new TAnonymousFile);
    file->fDescriptor = TDescriptor(memfd_create("cimdelta", MFD_CLOEXEC));
    if (!file->fDescriptor || TryWriteWhole(file->fDescriptor.Get(), content)) {
        return nullptr;
    }
    file->fPath = "/proc/self/fd/" + std::to_string(file->fDescriptor.Get());
    return CanBeOpened(file->fPath) ? std::move(file) : nullptr;
}

}  // namespace NORVZEL20

#include "client/files/TAnonymousFile.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

namespace {

bool CanBeOpened(const std::string& path)
{
    const int descriptor = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    return descriptor >= 0 && close(descriptor) == 0;
}

}  // namespace

TAnonymousFile::~TAnonymousFile()
{
    if (fDescriptor >= 0) {
        close(fDescriptor);
    }
}

std::unique_ptr<TAnonymousFile> TAnonymousFile::TryMake(const std::string& content)
{
    std::unique_ptr<TAnonymousFile> file(new TAnonymousFile);
    file->fDescriptor = memfd_create("cimdelta", MFD_CLOEXEC);
    if (file->fDescriptor < 0 || TryWriteWhole(file->fDescriptor, content)) {
        return nullptr;
    }
    file->fPath = "/proc/self/fd/" + std::to_string(file->fDescriptor);
    return CanBeOpened(file->fPath) ? std::move(file) : nullptr;
}

}  // namespace NORVZEL20

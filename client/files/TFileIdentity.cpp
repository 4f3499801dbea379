#include "client/files/TFileIdentity.h"

#include <sys/stat.h>
#include <unistd.h>

#include "client/process/StandardDescriptors.h"

namespace NORVZEL20 {

std::optional<TFileIdentity> IdentifyFile(const std::string& path) noexcept
{
    struct stat status;
    if (path == "-" ? IsClosed(STDIN_FILENO) || fstat(STDIN_FILENO, &status) != 0 : stat(path.c_str(), &status) != 0) {
        return std::nullopt;
    }
    return TFileIdentity{status.st_dev, status.st_ino};
}

}  // namespace NORVZEL20

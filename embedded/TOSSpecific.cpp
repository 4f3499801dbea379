#include "host/TOSSpecific.h"

#include <cstdlib>
#include <filesystem>

#include "host/TZELException.h"

namespace NORVZEL20 {

std::string TOSSpecific::GetZELRootPath()
{
    const char* const chosen = std::getenv("CIMDELTA_ROOT");
    if (chosen != nullptr && *chosen != '\0') {
        return chosen;
    }
    std::error_code error;
    if (std::filesystem::exists(CIMDELTA_INSTALLED_ROOT "/data/deltaclasses.properties.xml", error)) {
        return CIMDELTA_INSTALLED_ROOT;
    }
    return CIMDELTA_SOURCE_ROOT;
}

std::uint64_t TOSSpecific::GetFileSize(std::string path)
{
    std::error_code error;
    const std::uintmax_t size = std::filesystem::file_size(path, error);
    if (error) {
        throw TZELException(TZELStatusCode::kFileError);
    }
    return size;
}

}  // namespace NORVZEL20

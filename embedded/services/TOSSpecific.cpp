// Where the host finds its data.
//
//  1. CIMDELTA_ROOT, if it is set and not empty.
//  2. The place for data of the package that the library is installed in. It is relative to the library, so a package can be moved.
//  3. In a build tree there is no such place. There the folder "root", beside that of the libraries, has a link to the data of the
//     sources. It is used only if it has data and the place of the package has none.

#include "host/TOSSpecific.h"

#include <dlfcn.h>

#include <cstdlib>
#include <filesystem>

#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

/// The folder of this library, with links resolved; empty if the system does not know it.
std::filesystem::path FindLibraryFolder()
{
    static const char inTheLibrary = '\0';  // any address in the library will do
    Dl_info info;
    std::error_code error;
    if (dladdr(&inTheLibrary, &info) == 0 || info.dli_fname == nullptr) {
        return std::filesystem::path();
    }
    return std::filesystem::canonical(info.dli_fname, error).parent_path();
}

}  // namespace

std::string TOSSpecific::GetZELRootPath()
{
    const char* const chosen = std::getenv("CIMDELTA_ROOT");
    if (chosen != nullptr && *chosen != '\0') {
        return chosen;
    }
    const std::filesystem::path folder = FindLibraryFolder();
    const std::filesystem::path installed = folder / CIMDELTA_INSTALLED_ROOT;
    const std::filesystem::path built = folder / CIMDELTA_BUILD_ROOT;
    std::error_code error;
    const bool isBuilt = !std::filesystem::exists(installed / "data", error) && std::filesystem::exists(built / "data", error);
    return (isBuilt ? built : installed).lexically_normal().string();
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

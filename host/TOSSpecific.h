#pragma once

#include <cstdint>
#include <string>

namespace NORVZEL20 {

/// What depends on the operating system.
class TOSSpecific {
  public:
    TOSSpecific() = delete;

    /// The host's installation root, with or without a separator at its end; its folder "data" holds the schemas.
    ///
    /// The value of the environment variable CIMDELTA_ROOT where it is set and not empty. Else it is told by where the library
    /// lies: the folder share/cimdelta of the package that it was installed with, or the build tree's link to the sources.
    static std::string GetZELRootPath();

    /// The size of the named file in bytes. Errors: TZELException with status 11 where there is no such file.
    static std::uint64_t GetFileSize(std::string path);
};

}  // namespace NORVZEL20

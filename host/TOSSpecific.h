#pragma once

#include <cstdint>
#include <string>

#include "host/Export.h"

namespace NORVZEL20 {

/// The parts of the host that depend on the operating system.
class CIMDELTA_EXPORT TOSSpecific {
  public:
    TOSSpecific() = delete;

    /// The host's installation root, with or without a separator at its end. Its folder "data" has the schemas.
    ///
    /// This is the value of the environment variable CIMDELTA_ROOT if that is set and not empty. Otherwise it depends on the place
    /// of the library: an installed one uses the folder share/cimdelta of its package, one in a build tree the tree's link to the
    /// sources.
    static std::string GetZELRootPath();

    /// The size of the named file in bytes. Errors: TZELException with kFileError (11) if there is no such file.
    static std::uint64_t GetFileSize(std::string path);
};

}  // namespace NORVZEL20

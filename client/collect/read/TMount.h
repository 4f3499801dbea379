#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// A file system where it is mounted.
struct TMount {
    std::string path;
    std::string type;
    std::string source;
    std::string sourceFolder;
    std::vector<std::string> options;            ///< of this mount
    std::vector<std::string> fileSystemOptions;  ///< of the file system, wherever it is mounted
};

}  // namespace NORVZEL20

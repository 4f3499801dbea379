#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// What a folder holds. Hidden names, which begin with a dot, are in neither list.
struct TFolderListing {
    std::vector<std::string> files;   ///< paths of the ordinary files, in ascending order of their names
    std::vector<std::string> others;  ///< names of everything else: links, whatever they lead to, folders, pipes and so on
};

/// Lists the folder at `path`. Errors: TClientError if it cannot be read.
TFolderListing ListFolder(const std::string& path);

}  // namespace NORVZEL20

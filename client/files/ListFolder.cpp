#include "client/files/ListFolder.h"

#include <algorithm>
#include <filesystem>

#include "client/process/TClientError.h"

namespace NORVZEL20 {

TFolderListing ListFolder(const std::string& path)
{
    TFolderListing listing;
    try {
        for (const std::filesystem::directory_entry& entry : std::filesystem::directory_iterator(path)) {
            const std::string name = entry.path().filename().string();
            if (name.front() == '.') {
                continue;
            }
            // A link may lead out of the folder, so none is followed.
            if (entry.symlink_status().type() == std::filesystem::file_type::regular) {
                listing.files.push_back(entry.path().string());
            } else {
                listing.others.push_back(name);
            }
        }
    } catch (const std::filesystem::filesystem_error& error) {
        throw TClientError(path + ": cannot be read", error.code());
    }
    std::sort(listing.files.begin(), listing.files.end());
    std::sort(listing.others.begin(), listing.others.end());
    return listing;
}

}  // namespace NORVZEL20

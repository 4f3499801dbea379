#include "client/inventory/CheckInventoryFiles.h"

#include <sys/stat.h>

#include <set>

#include "client/files/TInputFile.h"
#include "client/inventory/TInventoryFile.h"
#include "client/process/TClientError.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

// Whether a path leads to a pipe or a device.
bool IsStream(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode) && !S_ISDIR(status.st_mode);
}

void CheckFile(const std::string& path)
{
    if (path == "-") {
        const TInputFile file(path);
        return;
    }
    if (IsStream(path)) {
        // Opening a pipe may wait for a writer, and closing it ends the writer.
        return;
    }
    const TInventoryFile file(path);
}

}  // namespace

void CheckInventoryFiles(const std::vector<std::string>& paths)
{
    std::string message;
    std::vector<std::string> others;
    for (const std::string& path : paths) {
        try {
            CheckFile(path);
        } catch (const TClientError& error) {
            if (message.empty()) {
                message = error.what();
            } else {
                others.push_back(path);
            }
        }
    }
    if (!message.empty()) {
        throw TClientError(
            others.empty() ? message : message + "; " + std::to_string(others.size()) + " more cannot be read: " + SomeOf(others));
    }
}

void RequireReadableOnce(const std::vector<TInventorySources>& inventories, const std::vector<std::string>& schemas,
                         const std::string& rules)
{
    std::vector<std::string> paths = schemas;
    paths.push_back(rules);
    for (const TInventorySources& sources : inventories) {
        paths.insert(paths.end(), sources.files.begin(), sources.files.end());
    }
    RequireOneStandardInput(paths);
    std::set<std::string> streams;
    for (const std::string& path : paths) {
        if (IsStream(path) && path != "/dev/null" && !streams.insert(path).second) {
            throw TClientError(path + ": is a pipe or a device, which can be read only once; save it to a file first");
        }
    }
}

}  // namespace NORVZEL20

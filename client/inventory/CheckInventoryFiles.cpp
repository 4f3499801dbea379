#include "client/inventory/CheckInventoryFiles.h"

#include <sys/stat.h>

#include "client/files/TInputFile.h"
#include "client/inventory/TInventoryFile.h"
#include "client/process/TClientError.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

void CheckFile(const std::string& path)
{
    if (path == "-") {
        const TInputFile file(path);
        return;
    }
    struct stat status;
    if (stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode) && !S_ISDIR(status.st_mode)) {
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

}  // namespace NORVZEL20

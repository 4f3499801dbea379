#include "client/inventory/TIncludedFiles.h"

#include <utility>

#include "client/files/TFileIdentity.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {

TIncludedFiles::TIncludedFiles(std::string output) : fOutput(std::move(output)) {}

bool TIncludedFiles::Find(const std::string& name, const std::string& from, TFile& file, std::string& reason)
{
    return fFolders.Find(name, from, file, reason);
}

// Which files are included shows only as they are read, so this cannot be checked before the inventories are loaded.
bool TIncludedFiles::Read(const TFile& file, std::size_t most, std::string& bytes, std::string& reason)
{
    if (!fOutput.empty()) {
        const std::optional<TFileIdentity> output = IdentifyFile(fOutput);
        const std::optional<TFileIdentity> input = IdentifyFile(file.identity);
        if (output && input && *output == *input) {
            throw TClientError(fOutput + ": is one of the files that are read, since " + file.name +
                               " is included; name another file for the result");
        }
    }
    return fFolders.Read(file, most, bytes, reason);
}

}  // namespace NORVZEL20

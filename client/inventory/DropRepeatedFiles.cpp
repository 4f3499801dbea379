#include "client/inventory/DropRepeatedFiles.h"

#include <algorithm>
#include <map>

#include "client/files/TFileIdentity.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

struct TKept {
    std::string path;
    std::optional<TFileIdentity> identity;
};

bool IsSame(const TKept& a, const TKept& b)
{
    if (a.path == "-" && b.path == "-") {
        return false;
    }
    return a.path == b.path || (a.identity && b.identity && *a.identity == *b.identity);
}

std::string Note(const std::string& path, const std::string& earlier)
{
    return "cimdelta: " + path + ": " + (path == earlier ? "is named more than once" : "is the same file as " + earlier) +
           "; it is used once";
}

}  // namespace

std::vector<std::string> DropRepeatedFiles(const std::vector<std::string>& paths, std::size_t fewest, IConsole& console)
{
    std::vector<TKept> kept;
    std::map<std::string, std::string> notes;  // by the path that is dropped
    for (const std::string& path : paths) {
        const TKept file = {path, IdentifyFile(path)};
        const auto earlier = std::find_if(kept.begin(), kept.end(), [&](const TKept& other) { return IsSame(file, other); });
        if (earlier == kept.end()) {
            kept.push_back(file);
        } else {
            notes.emplace(path, Note(path, earlier->path));
        }
    }
    if (kept.size() < std::min(fewest, paths.size())) {
        throw TClientError("all inventories are the same file, " + paths.front() + "; name another one to compare it with");
    }
    for (const auto& note : notes) {
        console.Say(note.second);
    }
    std::vector<std::string> different;
    for (const TKept& file : kept) {
        different.push_back(file.path);
    }
    return different;
}

}  // namespace NORVZEL20

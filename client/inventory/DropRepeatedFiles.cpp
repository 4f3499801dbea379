#include "client/inventory/DropRepeatedFiles.h"

#include <algorithm>
#include <map>

#include "client/files/TFileIdentity.h"
#include "client/process/TClientError.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

struct TKept {
    std::string name;  // what notes call it
    std::vector<std::string> paths;
    std::vector<std::optional<TFileIdentity>> identities;
};

TKept Identify(const std::string& name, const std::vector<std::string>& paths)
{
    TKept kept = {name, paths, {}};
    for (const std::string& path : paths) {
        kept.identities.push_back(IdentifyFile(path));
    }
    return kept;
}

bool IsSameFile(const TKept& a, std::size_t i, const TKept& b, std::size_t j)
{
    if (a.paths[i] == "-" && b.paths[j] == "-") {
        return false;
    }
    return a.paths[i] == b.paths[j] || (a.identities[i] && b.identities[j] && *a.identities[i] == *b.identities[j]);
}

// Whether both consist of the same files, in any order. Neither has a file twice.
bool IsSame(const TKept& a, const TKept& b)
{
    if (a.paths.size() != b.paths.size()) {
        return false;
    }
    for (std::size_t i = 0; i < a.paths.size(); ++i) {
        bool isFound = false;
        for (std::size_t j = 0; j < b.paths.size() && !isFound; ++j) {
            isFound = IsSameFile(a, i, b, j);
        }
        if (!isFound) {
            return false;
        }
    }
    return true;
}

std::string Note(const TKept& file, const TKept& earlier)
{
    const std::string same = file.paths.size() == 1 ? "is the same file as " : "consists of the same files as ";
    return "cimdelta: " + file.name + ": " + (file.name == earlier.name ? "is named more than once" : same + earlier.name) +
           "; it is used once";
}

// Those that are kept, in order; `notes` gets one for each name that is dropped.
std::vector<std::size_t> FindDifferent(const std::vector<TKept>& all, std::map<std::string, std::string>& notes)
{
    std::vector<std::size_t> kept;
    for (std::size_t i = 0; i < all.size(); ++i) {
        const auto earlier = std::find_if(kept.begin(), kept.end(), [&](std::size_t other) { return IsSame(all[i], all[other]); });
        if (earlier == kept.end()) {
            kept.push_back(i);
        } else {
            notes.emplace(all[i].name, Note(all[i], all[*earlier]));
        }
    }
    return kept;
}

void SayAll(const std::map<std::string, std::string>& notes, IConsole& console)
{
    for (const auto& note : notes) {
        console.Say(note.second);
    }
}

// A folder that is named twice would give a note for each of its files.
const std::size_t kMostNotes = 3;

void SayTogether(const std::map<std::string, std::string>& notes, IConsole& console)
{
    std::vector<std::string> names;
    for (const auto& note : notes) {
        names.push_back(note.first);
    }
    console.Say("cimdelta: these files come more than once, each is used once: " + SomeOf(names));
}

}  // namespace

std::vector<std::string> DropRepeatedFiles(const std::vector<std::string>& paths, IConsole& console)
{
    std::vector<TKept> files;
    for (const std::string& path : paths) {
        files.push_back(Identify(path, {path}));
    }
    std::map<std::string, std::string> notes;
    std::vector<std::string> different;
    for (const std::size_t i : FindDifferent(files, notes)) {
        different.push_back(paths[i]);
    }
    if (notes.size() <= kMostNotes) {
        SayAll(notes, console);
    } else {
        SayTogether(notes, console);
    }
    return different;
}

std::vector<TInventorySources> DropRepeatedInventories(std::vector<TInventorySources> inventories, std::size_t fewest,
                                                       IConsole& console)
{
    std::vector<TKept> all;
    for (TInventorySources& sources : inventories) {
        sources.files = DropRepeatedFiles(sources.files, console);
        all.push_back(Identify(sources.argument, sources.files));
    }
    std::map<std::string, std::string> notes;
    const std::vector<std::size_t> kept = FindDifferent(all, notes);
    if (kept.size() < std::min(fewest, inventories.size())) {
        throw TClientError("all inventories are the same " + std::string(all.front().paths.size() == 1 ? "file, " : "files, ") +
                           inventories.front().argument + "; name another one to compare it with");
    }
    SayAll(notes, console);
    std::vector<TInventorySources> different;
    for (const std::size_t i : kept) {
        different.push_back(std::move(inventories[i]));
    }
    return different;
}

}  // namespace NORVZEL20

#include "client/inventory/InventoryLabels.h"

#include <map>
#include <set>
#include <string_view>

#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

// Removes the suffix, unless the name is nothing else.
bool TakeOff(std::string& name, std::string_view suffix)
{
    if (name.size() <= suffix.size() || name.compare(name.size() - suffix.size(), suffix.size(), suffix) != 0) {
        return false;
    }
    name.resize(name.size() - suffix.size());
    return true;
}

void TakeOffOneOf(std::string& name, std::initializer_list<std::string_view> suffixes)
{
    for (const std::string_view suffix : suffixes) {
        if (TakeOff(name, suffix)) {
            return;
        }
    }
}

std::string ShortName(const std::string& path)
{
    if (path == "-") {
        return "stdin";
    }
    std::string name = path.substr(path.rfind('/') + 1);
    // The suffix of the compression comes last in the name, so it is taken off first.
    TakeOffOneOf(name, {".gz", ".xz", ".zst"});
    TakeOffOneOf(name, {".xml", ".cimxml", ".cim"});
    return name.empty() ? path : name;
}

std::map<std::string, int> CountOf(const std::vector<std::string>& names)
{
    std::map<std::string, int> count;
    for (const std::string& name : names) {
        ++count[name];
    }
    return count;
}

}  // namespace

std::vector<std::string> MakeInventoryLabels(const std::vector<std::string>& paths)
{
    std::vector<std::string> labels;
    for (const std::string& path : paths) {
        labels.push_back(EscapeForDisplay(ShortName(path)));
    }
    const std::map<std::string, int> count = CountOf(labels);
    for (std::size_t i = 0; i < labels.size(); ++i) {
        if (count.at(labels[i]) > 1) {
            labels[i] = EscapeForDisplay(paths[i]);
        }
    }
    // A file may itself be called "a#2", so a number is skipped if its label is taken.
    std::set<std::string> taken;
    for (std::string& label : labels) {
        const std::string plain = label;
        for (int number = 2; !taken.insert(label).second; ++number) {
            label = plain + "#" + std::to_string(number);
        }
    }
    return labels;
}

}  // namespace NORVZEL20

#include "client/inventory/InventoryLabels.h"

#include <map>
#include <set>
#include <string_view>

#include <boost/algorithm/string/predicate.hpp>

#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

// Removes the suffix in any letter case, unless the name is nothing else.
bool TakeOff(std::string& name, std::string_view suffix)
{
    if (name.size() <= suffix.size() || !boost::algorithm::iends_with(name, suffix)) {
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
    const std::size_t end = path.find_last_not_of('/');  // slashes behind the name of a folder do not count
    const std::string trimmed = path.substr(0, end == std::string::npos ? path.size() : end + 1);
    std::string name = trimmed.substr(trimmed.rfind('/') + 1);
    // The suffix of the compression comes last in the name, so it is taken off first.
    TakeOffOneOf(name, {".gz", ".xz", ".zst"});
    TakeOffOneOf(name, {".xml", ".cimxml", ".cim", ".mof"});
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

// The labels that were given; they stay as they are.
std::set<std::string> CollectGiven(const std::vector<TInventorySources>& inventories)
{
    std::set<std::string> given;
    for (const TInventorySources& sources : inventories) {
        const std::string label = EscapeForDisplay(sources.label);
        if (!label.empty() && !given.insert(label).second) {
            throw TClientError("two inventories have the label " + label + "; give them different ones");
        }
    }
    return given;
}

}  // namespace

std::vector<std::string> MakeInventoryLabels(const std::vector<TInventorySources>& inventories)
{
    std::set<std::string> taken = CollectGiven(inventories);
    std::vector<std::string> labels;
    for (const TInventorySources& sources : inventories) {
        labels.push_back(EscapeForDisplay(sources.label.empty() ? ShortName(sources.firstSource) : sources.label));
    }
    const std::map<std::string, int> count = CountOf(labels);
    for (std::size_t i = 0; i < labels.size(); ++i) {
        if (!inventories[i].label.empty()) {
            continue;
        }
        if (count.at(labels[i]) > 1) {
            labels[i] = EscapeForDisplay(inventories[i].firstSource);
        }
        // A file may itself be called "a#2", so a number is skipped if its label is taken.
        const std::string plain = labels[i];
        for (int number = 2; !taken.insert(labels[i]).second; ++number) {
            labels[i] = plain + "#" + std::to_string(number);
        }
    }
    return labels;
}

}  // namespace NORVZEL20

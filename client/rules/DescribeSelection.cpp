#include "client/rules/DescribeSelection.h"

#include <boost/algorithm/string/join.hpp>
#include <utility>

#include "client/text/QuoteForShell.h"

namespace NORVZEL20 {

namespace {

const std::size_t kLongestDescription = 80;

std::vector<std::pair<std::string, const std::vector<std::string>*>> OptionsOf(const TSelection& selection)
{
    return {{"--class", &selection.classes},
            {"--property", &selection.properties},
            {"--exclude", &selection.excluded},
            {"--exclude-key", &selection.excludedKeys}};
}

}  // namespace

std::vector<std::string> ListSelection(const TSelection& selection)
{
    std::vector<std::string> options;
    for (const auto& [option, names] : OptionsOf(selection)) {
        for (const std::string& name : *names) {
            options.push_back(option + " " + QuoteForShell(name));
        }
    }
    return options;
}

std::string DescribeSelection(const TSelection& selection)
{
    const std::string whole = boost::algorithm::join(ListSelection(selection), " ");
    if (whole.size() <= kLongestDescription) {
        return whole;
    }
    std::vector<std::string> options;
    for (const auto& [option, names] : OptionsOf(selection)) {
        if (!names->empty()) {
            options.push_back(option + (names->size() > 1 ? " (" + std::to_string(names->size()) + " times)" : ""));
        }
    }
    return boost::algorithm::join(options, ", ");
}

}  // namespace NORVZEL20

#include "spec/TDiffClassRules.h"

#include <algorithm>
#include <utility>

namespace NORVZEL20 {

namespace {

/// What a formatted read of words skips.
const char kWhiteSpace[] = " \t\n\v\f\r";

}  // namespace

TCIMDiffEngine::TDiffClassRules::TDiffClassRules() : fDefault(EXCLUDE), fFinal(false) {}

TCIMDiffEngine::TDiffClassRules::TDiffClassRules(propType def, std::map<std::string, propType> props,
                                                 std::vector<std::string> excludedKeys)
    : fProperties(std::move(props)), fDefault(def), fFinal(false), fExcludedKeys(std::move(excludedKeys))
{}

void TCIMDiffEngine::TDiffClassRules::updateRules(boost::shared_ptr<TDiffClassRules> other)
{
    fDefault = other->fDefault;
    for (const auto& [name, type] : other->fProperties) {
        fProperties[name] = type;
    }
}

void TCIMDiffEngine::TDiffClassRules::excludeKeys(std::string list)
{
    // By hand: a stream takes a lack of memory for its end, and the names that follow would be lost without a word.
    std::size_t begin = list.find_first_not_of(kWhiteSpace);
    while (begin != std::string::npos) {
        const std::size_t end = std::min(list.find_first_of(kWhiteSpace, begin), list.size());
        fExcludedKeys.push_back(list.substr(begin, end - begin));
        begin = list.find_first_not_of(kWhiteSpace, end);
    }
}

bool TCIMDiffEngine::TDiffClassRules::hasExcludedKeys()
{
    return !fExcludedKeys.empty();
}

bool TCIMDiffEngine::TDiffClassRules::isKeyExcluded(const std::string& name)
{
    return std::find(fExcludedKeys.begin(), fExcludedKeys.end(), name) != fExcludedKeys.end();
}

}  // namespace NORVZEL20

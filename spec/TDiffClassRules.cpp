#include "spec/TDiffClassRules.h"

#include <algorithm>
#include <locale>
#include <sstream>
#include <utility>

namespace NORVZEL20 {

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
    std::istringstream words(list);
    words.exceptions(std::ios_base::badbit);  // otherwise a lack of memory would look like the end of the list
    words.imbue(std::locale::classic());      // the process's locale may take other characters for white space
    for (std::string word; words >> word;) {
        fExcludedKeys.push_back(word);
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

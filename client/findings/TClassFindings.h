#pragma once

#include <map>
#include <string>
#include <vector>

#include "client/comparison/TDifferenceCounts.h"
#include "client/findings/TPresenceFinding.h"
#include "client/findings/TPropertyFinding.h"
#include "client/text/TValueWords.h"

namespace NORVZEL20 {

/// What was found in the instances of one class.
struct TClassFindings {
    std::string className;
    TDifferenceCounts counts;
    std::vector<TPresenceFinding> presences;               ///< those of the reference first; then in the order of the differences
    std::vector<TPropertyFinding> properties;              ///< ascending by name; of the same name, those with fewest changes first
    std::map<std::string, std::size_t> changedProperties;  ///< how many changed values each has; an embedded instance is one
    std::map<std::string, TValueWords> words;              ///< for the values of the properties above and of contents

    /// The words for the values of that property.
    const TValueWords& WordsFor(const std::string& property) const
    {
        static const TValueWords fgNone;
        const auto found = words.find(property);
        return found == words.end() ? fgNone : found->second;
    }
};

}  // namespace NORVZEL20

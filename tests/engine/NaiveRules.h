#pragma once

#include <map>
#include <string>
#include <vector>

#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// The rules that apply to one class.
struct TNaiveRules {
    bool isIncluded = false;
    std::map<std::string, bool> listed;
    std::vector<std::string> excludedKeys;
    bool isClosed = false;

    bool IsExcludedKey(const std::string& name) const;
};

/// Thrown if the comparison of a set fails.
struct TNaiveFailure {
    int status;
};

/// The class of that name, or null.
const TNaiveClass* FindNaiveClass(const TNaiveNamespace& ns, const std::string& name);
/// All properties of a class, inherited ones first.
std::vector<TNaiveProperty> AllNaiveProperties(const TNaiveNamespace& ns, const std::string& className);

/// The rules of each class, after all elements were read in order. Errors: TNaiveFailure with kParseError (9) for an unknown name.
std::map<std::string, TNaiveRules> NaiveRulesOf(const TNaiveSet& set);

}  // namespace NORVZEL20

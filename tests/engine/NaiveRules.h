#pragma once

#include <map>
#include <string>
#include <vector>

#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// What the rules come to for one class.
struct TNaiveRules {
    bool isIncluded = false;
    std::map<std::string, bool> listed;
    std::vector<std::string> excludedKeys;
    bool isClosed = false;

    bool IsExcludedKey(const std::string& name) const;
};

/// What the comparison of a set ends with, where it fails.
struct TNaiveFailure {
    int status;
};

/// The class of that name, or null.
const TNaiveClass* FindNaiveClass(const TNaiveNamespace& ns, const std::string& name);
/// All properties of a class, inherited ones first.
std::vector<TNaiveProperty> AllNaiveProperties(const TNaiveNamespace& ns, const std::string& className);

/// The rules of each class, from the elements read one after the other. Throws TNaiveFailure 9 for an unknown name.
std::map<std::string, TNaiveRules> NaiveRulesOf(const TNaiveSet& set);

}  // namespace NORVZEL20

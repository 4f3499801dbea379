#include "tests/engine/NaiveRules.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

using TAllRules = std::map<std::string, TNaiveRules>;

void Merge(TAllRules& all, const std::string& className, const TNaiveRules& rules, bool isOwn)
{
    if (all.count(className) == 0) {
        all[className] = rules;
        all[className].isClosed = false;
        return;
    }
    TNaiveRules& entry = all[className];
    if (entry.isClosed) {
        return;
    }
    entry.isIncluded = rules.isIncluded;
    for (const auto& [name, isIncluded] : rules.listed) {
        entry.listed[name] = isIncluded;
    }
    entry.isClosed = isOwn;
}

void HandDown(TAllRules& all, const TNaiveNamespace& schema, const std::string& className)
{
    for (const auto& cls : schema.classes) {
        if (cls.superName == className) {
            Merge(all, cls.name, TNaiveRules(all[className]), false);
            HandDown(all, schema, cls.name);
        }
    }
}

TNaiveRules OwnRules(const TNaiveElement& element, const TNaiveNamespace& schema)
{
    if (!FindNaiveClass(schema, element.className)) {
        throw TNaiveFailure{9};
    }
    const auto properties = AllNaiveProperties(schema, element.className);
    TNaiveRules rules;
    rules.isIncluded = element.def == TNaiveElement::EDefault::kInclude;
    rules.excludedKeys = element.excludedKeys;
    for (const auto& [name, isIncluded] : element.listed) {
        const auto isIt = [&, &wanted = name](const TNaiveProperty& property) { return property.name == wanted; };
        if (std::none_of(properties.begin(), properties.end(), isIt)) {
            throw TNaiveFailure{9};
        }
        rules.listed.insert({name, isIncluded});
    }
    return rules;
}

}  // namespace

bool TNaiveRules::IsExcludedKey(const std::string& name) const
{
    return std::find(excludedKeys.begin(), excludedKeys.end(), name) != excludedKeys.end();
}

const TNaiveClass* FindNaiveClass(const TNaiveNamespace& ns, const std::string& name)
{
    for (const auto& cls : ns.classes) {
        if (cls.name == name) {
            return &cls;
        }
    }
    return nullptr;
}

std::vector<TNaiveProperty> AllNaiveProperties(const TNaiveNamespace& ns, const std::string& className)
{
    const TNaiveClass* cls = FindNaiveClass(ns, className);
    std::vector<TNaiveProperty> properties;
    if (!cls->superName.empty()) {
        properties = AllNaiveProperties(ns, cls->superName);
    }
    properties.insert(properties.end(), cls->properties.begin(), cls->properties.end());
    return properties;
}

std::map<std::string, TNaiveRules> NaiveRulesOf(const TNaiveSet& set)
{
    TAllRules all;
    for (const auto& element : set.rules) {
        Merge(all, element.className, OwnRules(element, set.namespaces[0]), true);
        HandDown(all, set.namespaces[0], element.className);
    }
    return all;
}

}  // namespace NORVZEL20

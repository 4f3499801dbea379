#include <boost/smart_ptr/make_shared.hpp>
#include <iostream>

#include "engine/TCIMDiffEngine.h"
#include "host/TAddToVectorCallback.h"
#include "spec/TDiffClassRules.h"

// How rules reach a class. At the end tag of each "class" element the parser makes two calls:
//
//     addToRuleset(cls, rules, true)     the rules of the element itself
//     updateRuleset(cls, "", schema)     the rules that the class has now, for every class below it, parents first
//
// addToRuleset copies the first rules of a class, whichever of the two adds them, and merges later ones into the copy. Merging an
// element's own rules makes them final. So if a class and its ancestor both have an element, the class keeps its own rules only if
// the ancestor's element comes first. That is the order for a specification: general classes before special ones.
//
// A class without an entry has rules that exclude everything.

namespace NORVZEL20 {

std::string TCIMDiffEngine::strPropType(propType type)
{
    return type == INCLUDE ? "INCLUDE" : "EXCLUDE";
}

boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> TCIMDiffEngine::TRuleset::getClassRules(std::string className)
{
    const auto entry = fRules.find(className);
    return entry != fRules.end() ? entry->second : boost::make_shared<TDiffClassRules>();
}

void TCIMDiffEngine::TRuleset::addToRuleset(std::string className, boost::shared_ptr<TDiffClassRules> rules, bool isExplicit)
{
    const auto entry = fRules.find(className);
    if (entry == fRules.end()) {
        // A copy, because later rules are merged into the entry and must not change the caller's.
        fRules[className] = boost::make_shared<TDiffClassRules>(rules->fDefault, rules->fProperties, rules->fExcludedKeys);
        return;
    }
    if (entry->second->fFinal) {
        return;
    }
    entry->second->updateRules(rules);
    if (isExplicit) {
        entry->second->fFinal = true;
    }
}

void TCIMDiffEngine::TRuleset::updateRuleset(std::string className, std::string parentName, boost::shared_ptr<ICIMNamespace> schema)
{
    if (!parentName.empty()) {
        addToRuleset(className, fRules[parentName], false);
    }
    const boost::shared_ptr<ICIMClass> cls = schema->GetClass(className, TCallContext());
    std::vector<boost::shared_ptr<ICIMClass>> subClasses;
    cls->EnumerateSubClasses(TAddToVectorCallback<ICIMClass>(&subClasses), false, TCallContext());
    for (const boost::shared_ptr<ICIMClass>& subClass : subClasses) {
        updateRuleset(subClass->GetName(TCallContext()), className, schema);
    }
}

void TCIMDiffEngine::TRuleset::print()
{
    for (const auto& [className, rules] : fRules) {
        std::cout << className << std::endl;
        std::cout << "\tDefault:\t" << strPropType(rules->fDefault) << std::endl;
        for (const auto& [name, type] : rules->fProperties) {
            std::cout << '\t' << name << '\t' << strPropType(type) << std::endl;
        }
    }
}

}  // namespace NORVZEL20

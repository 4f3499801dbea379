#include "engine/TCIMDiffEngine.h"

#include <algorithm>
#include <utility>

#include "engine/Borrow.h"
#include "engine/TClassComparison.h"
#include "engine/TMapCursor.h"
#include "engine/TMasterInstance.h"
#include "host/RootClassName.h"
#include "host/TAddToVectorCallback.h"
#include "provider/DeltaNames.h"
#include "spec/TDiffClassRules.h"

// The walk goes down the class tree of the reference, from the class "<root>":
//
//     compare()       the subclasses of "<root>", in the reference's order
//     compare(cls)    the class itself (TClassComparison), then its subclasses
//
// A class is finished, with its records written, before any class below it is looked at. Each class is compared with its own
// instances only: enumerations are never deep. Classes that only other namespaces have are not visited.
//
// No rules at all (one namespace, or the marker in the file name) means that every class excludes every property, and a class
// without properties to compare is skipped. The tree is then walked without any comparison.

namespace NORVZEL20 {

namespace {

std::vector<std::string> GetDeclaredNames(ICIMClass& cls)
{
    std::vector<boost::shared_ptr<ICIMPropertyDecl>> decls;
    cls.EnumeratePropertyDecls(TAddToVectorCallback<ICIMPropertyDecl>(&decls), TCallContext());
    std::vector<std::string> names;
    for (const boost::shared_ptr<ICIMPropertyDecl>& decl : decls) {
        const std::string& name = decl->GetName(TCallContext());
        if (name != kCollectionTime) {
            names.push_back(name);
        }
    }
    return names;
}

}  // namespace

TCIMDiffEngine::TCIMDiffEngine(boost::shared_ptr<ICIMNamespace> ns, std::vector<boost::shared_ptr<ICIMNamespace>>& compared,
                               std::string specFileName)
    : deltaNamespace(std::move(ns)), namespaces(compared)
{
    if (namespaces.size() == 1 || specFileName.find(kNoRulesMarker) != std::string::npos) {
        return;
    }
    CheckOperatingSystems();
    ruleset = ReadSpecFile(specFileName);
}

void TCIMDiffEngine::compare()
{
    const boost::shared_ptr<ICIMClass> root = namespaces.at(0)->GetClass(kRootClassName, TCallContext());
    CompareSubClasses(*root);
}

void TCIMDiffEngine::compare(boost::shared_ptr<ICIMClass> cls)
{
    TClassComparison(*this, cls).Run();
    CompareSubClasses(*cls);
}

void TCIMDiffEngine::CompareSubClasses(ICIMClass& cls)
{
    std::vector<boost::shared_ptr<ICIMClass>> subClasses;
    cls.EnumerateSubClasses(TAddToVectorCallback<ICIMClass>(&subClasses), false, TCallContext());
    for (const boost::shared_ptr<ICIMClass>& subClass : subClasses) {
        compare(subClass);
    }
}

std::vector<std::string> TCIMDiffEngine::buildPropList(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMClass> cls)
{
    const bool excludesByDefault = rules->fDefault == EXCLUDE;
    std::vector<std::string> names = excludesByDefault ? std::vector<std::string>() : GetDeclaredNames(*cls);
    for (const auto& [name, type] : rules->fProperties) {
        if (excludesByDefault && type == INCLUDE) {
            names.push_back(name);
        } else if (!excludesByDefault && type == EXCLUDE) {
            names.erase(std::remove(names.begin(), names.end(), name), names.end());
        }
    }
    return names;
}

void TCIMDiffEngine::buildInstanceMap(boost::shared_ptr<TDiffClassRules> rules,
                                      std::vector<boost::shared_ptr<ICIMInstance>>& instances,
                                      std::map<std::string, TMasterInstance>& masterMap)
{
    const boost::shared_ptr<TDiffClassRules> borrowedRules = Borrow(rules);
    TMapCursor<std::map<std::string, TMasterInstance>> place(masterMap);
    for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
        TMasterInstance& master = place.FindOrAdd(buildPath(borrowedRules, Borrow(instance))).second;
        if (!master.instance) {
            master.instance = instance;
        }
    }
}

}  // namespace NORVZEL20

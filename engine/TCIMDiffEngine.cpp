#include "engine/TCIMDiffEngine.h"

#include <algorithm>
#include <utility>

#include "engine/TClassComparison.h"
#include "engine/TMasterInstance.h"
#include "host/RootClassName.h"
#include "host/TAddToVectorCallback.h"
#include "provider/DeltaNames.h"
#include "spec/TDiffClassRules.h"

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
    for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
        masterMap.emplace(buildPath(rules, instance), TMasterInstance{instance});
    }
}

}  // namespace NORVZEL20

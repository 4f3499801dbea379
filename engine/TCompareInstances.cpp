#include "engine/TCompareInstances.h"

#include <utility>

#include "engine/TMasterInstance.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

TCIMDiffEngine::TCompareInstances::TCompareInstances(TCIMDiffEngine* engine, boost::shared_ptr<TDiffClassRules> rules,
                                                     std::map<std::string, TMasterInstance>* masterMap,
                                                     std::map<std::string, std::vector<int>>* missingMap,
                                                     std::map<std::string, std::map<std::string, std::vector<int>>>* differenceMap,
                                                     unsigned int namespaceIndex, std::vector<std::string>* propertyList)
    : fEngine(engine), fRules(std::move(rules)), fMasterMap(masterMap), fMissingMap(missingMap), fDifferenceMap(differenceMap),
      fNamespaceIndex(namespaceIndex), fPropertyList(propertyList)
{}

bool TCIMDiffEngine::TCompareInstances::operator()(boost::shared_ptr<ICIMInstance> instance)
{
    const std::string key = fEngine->buildPath(fRules, instance);
    const auto master = fMasterMap->find(key);
    if (master != fMasterMap->end()) {
        master->second.found = 1;
        fEngine->compare(fRules, master->second.instance, instance, key, *fPropertyList, *fDifferenceMap, fNamespaceIndex);
        return true;
    }
    (*fMissingMap)[key].push_back(static_cast<int>(fNamespaceIndex));
    if (fRules->hasExcludedKeys()) {
        // The key may stand for several instances. Its alias names the first one.
        const TCIMReference path = instance->GetReference(TCallContext());
        const boost::shared_ptr<ICIMClass> cls = instance->GetClass(TCallContext());
        fEngine->createObjectPathAlias(cls->GetName(TCallContext()), key, path, fNamespaceIndex);
    }
    return true;
}

}  // namespace NORVZEL20

#include "engine/TCompareInstances.h"

#include <utility>

#include "engine/Borrow.h"
#include "engine/TInstanceWalk.h"
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

std::string TCIMDiffEngine::TCompareInstances::BuildKey(const boost::shared_ptr<ICIMInstance>& instance)
{
    return fEngine->buildPath(Borrow(fRules), Borrow(instance));
}

bool TCIMDiffEngine::TCompareInstances::operator()(boost::shared_ptr<ICIMInstance> instance)
{
    // A walk of one step: it has no place from before.
    TInstanceWalk::TState state{TMapCursor<std::map<std::string, TMasterInstance>>(*fMasterMap),
                                TMapCursor<std::map<std::string, std::vector<int>>>(*fMissingMap)};
    return TInstanceWalk(*this, &state)(std::move(instance));
}

void TCIMDiffEngine::TCompareInstances::Match(TMasterInstance& master, std::string key, boost::shared_ptr<ICIMInstance> instance)
{
    master.found = 1;
    fEngine->compare(Borrow(fRules), Borrow(master.instance), std::move(instance), std::move(key), *fPropertyList, *fDifferenceMap,
                     fNamespaceIndex);
}

void TCIMDiffEngine::TCompareInstances::NoteMissing(const std::string& key, std::vector<int>& indices, const ICIMInstance& instance)
{
    indices.push_back(static_cast<int>(fNamespaceIndex));
    if (fRules->hasExcludedKeys()) {
        // The key may stand for several instances. Its alias names the first one.
        const TCIMReference path = instance.GetReference(TCallContext());
        const boost::shared_ptr<ICIMClass> cls = instance.GetClass(TCallContext());
        fEngine->createObjectPathAlias(cls->GetName(TCallContext()), key, path, fNamespaceIndex);
    }
}

}  // namespace NORVZEL20

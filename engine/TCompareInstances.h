#pragma once

#include "engine/TCIMDiffEngine.h"
#include "host/TUnaryFunction.h"

namespace NORVZEL20 {

/// Receives the instances of one class of one namespace, and compares each with the reference's instance of the same key.
///
/// Pass it to ICIMClass::EnumerateInstances. It owns the rules only; everything else is the caller's and must outlive the
/// enumeration.
class TCIMDiffEngine::TCompareInstances : public TUnaryFunction<boost::shared_ptr<ICIMInstance>> {
  public:
    TCompareInstances(TCIMDiffEngine* engine, boost::shared_ptr<TDiffClassRules> rules,
                      std::map<std::string, TMasterInstance>* masterMap, std::map<std::string, std::vector<int>>* missingMap,
                      std::map<std::string, std::map<std::string, std::vector<int>>>* differenceMap, unsigned int namespaceIndex,
                      std::vector<std::string>* propertyList);
    TCompareInstances(const TCompareInstances& other) = default;

    /// If the reference has an instance of the same key, marks that one as found and compares the two. Otherwise enters the key as
    /// missing from the reference. Always returns true, so the enumeration continues.
    bool operator()(boost::shared_ptr<ICIMInstance> instance);

  protected:
    std::string BuildKey(const boost::shared_ptr<ICIMInstance>& instance);
    /// For a key that the reference has: `master` is its entry.
    void Match(TMasterInstance& master, std::string key, boost::shared_ptr<ICIMInstance> instance);
    /// For a key that the reference lacks: `indices` are those of its entry in the missing map.
    void NoteMissing(const std::string& key, std::vector<int>& indices, const ICIMInstance& instance);

  private:
    TCIMDiffEngine* fEngine;
    boost::shared_ptr<TDiffClassRules> fRules;
    std::map<std::string, TMasterInstance>* fMasterMap;
    std::map<std::string, std::vector<int>>* fMissingMap;
    std::map<std::string, std::map<std::string, std::vector<int>>>* fDifferenceMap;
    unsigned int fNamespaceIndex;
    std::vector<std::string>* fPropertyList;
};

}  // namespace NORVZEL20

#pragma once

#include "engine/TCIMDiffEngine.h"
#include "engine/TMapCursor.h"
#include "engine/TMasterInstance.h"

namespace NORVZEL20 {

/// The comparison of one class of the reference with the class of the same name in every other namespace, without subclasses.
class TCIMDiffEngine::TClassComparison {
  public:
    TClassComparison(TCIMDiffEngine& engine, boost::shared_ptr<ICIMClass> cls);

    /// Compares and writes the records. Call it once. Errors: as TCIMDiffEngine::compare.
    void Run();

  private:
    using TIndices = std::vector<int>;
    using TMasterCursor = TMapCursor<std::map<std::string, TMasterInstance>>;
    using TIndicesCursor = TMapCursor<std::map<std::string, TIndices>>;

    void CollectReferenceInstances();
    void CompareWithNamespace(std::size_t index);
    bool FindClassIn(std::size_t index);
    [[noreturn]] void FailWithoutClassIn(std::size_t index) const;
    void NoteAbsentInstances(std::size_t index);
    bool IsAnythingDifferent() const;
    void CreateClassRecord();
    void RecordAbsentInstances(bool excludesKeys);
    void RecordAbsentInstance(const std::string& key, const ICIMInstance& instance, const TIndices& indices, bool excludesKeys);
    void RecordMissingInstances();
    void CollectMissingInstances(std::map<std::string, TMasterInstance>& others);
    void RecordDifferences();
    void CopyToReference(boost::shared_ptr<ICIMInstance> instance);
    bool HasTwoNamespaces() const;

    TCIMDiffEngine& fEngine;
    boost::shared_ptr<ICIMClass> fClass;
    std::string fClassName;
    boost::shared_ptr<TDiffClassRules> fRules;
    std::vector<std::string> fProperties;
    boost::shared_ptr<ICIMClass> fOtherClass;  // of the last namespace that has the class
    std::map<std::string, TMasterInstance> fMaster;
    std::map<std::string, TIndices> fAbsent;   // by key, the namespaces that lack the instance
    std::map<std::string, TIndices> fMissing;  // by key, the namespaces whose instance the reference lacks
    std::map<std::string, std::map<std::string, TIndices>> fDifferences;  // by key and property
    boost::shared_ptr<ICIMInstance> fClassRecord;
};

}  // namespace NORVZEL20

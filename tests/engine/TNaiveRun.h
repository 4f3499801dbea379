#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

#include "tests/engine/NaiveRules.h"
#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// The naive comparison of one set, class by class. It compares every pair of instances.
///
/// Call Go once. Errors: TNaiveFailure; what was written before stays.
class TNaiveRun {
  public:
    explicit TNaiveRun(TNaiveSet& set) : fSet(set) {}

    void Go();
    std::string Records() const { return fRecords; }
    std::string Aliases() const;
    std::string Instances() const;

  private:
    using TInstances = std::vector<TNaiveInstance*>;
    using TIndices = std::map<std::string, std::vector<int>>;

    TNaiveNamespace& First() { return fSet.namespaces[0]; }
    bool AreTwo() const { return fSet.namespaces.size() == 2; }
    void CheckSystems() const;
    void NotePaths();
    void Visit(const std::string& className);
    void CompareClass(const std::string& className, const std::vector<std::string>& properties);
    void CompareWith(std::size_t index, const std::string& className, const TInstances& masters,
                     const std::vector<std::string>& properties);
    void ComparePair(std::size_t index, TNaiveInstance& master, TNaiveInstance& other, const std::vector<std::string>& properties);
    bool AreEqual(const TNaiveValue& master, const TNaiveValue& other) const;
    void Write(const std::string& className, const TInstances& masters);
    void WriteRecord(int type, const std::string& instance, const std::string& property, const std::vector<int>& indices);
    void Copy(const std::string& className, const std::string& key);
    std::vector<std::string> PropertiesToCompare(const std::string& className) const;
    std::string PathOfInstance(const TNaiveNamespace& ns, const TNaiveInstance& instance, const TNaiveRules& rules) const;
    std::string KeyOf(std::size_t index, const TNaiveInstance& instance) const;
    static TNaiveValue& ValueOf(TNaiveInstance& instance, const std::string& name) { return instance.values[name]; }
    void NeedProperty(std::size_t index, const std::string& className, const std::string& name) const;
    void NoteAlias(std::size_t index, const TNaiveInstance& instance, const std::string& key);
    TInstances InstancesOf(std::size_t index, const std::string& className);

    TNaiveSet& fSet;
    std::map<std::string, TNaiveRules> fAllRules;
    TNaiveRules fRules;                                        // of the class at hand
    std::map<const TNaiveInstance*, std::string> fMasterKeys;  // of the class at hand, as they were before it was compared
    TIndices fAbsent;
    TIndices fMissing;
    std::map<std::string, TIndices> fDifferent;
    std::string fRecords;
    std::map<std::pair<std::size_t, std::string>, std::map<std::string, std::string>> fAliases;
};

}  // namespace NORVZEL20

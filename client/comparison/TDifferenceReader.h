#pragma once

#include <memory>
#include <string>
#include <vector>

#include "client/comparison/TDeltaRecord.h"
#include "client/comparison/TDifference.h"
#include "client/comparison/TInstanceIndex.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Turns the records of a run into differences with values, which the records do not hold.
class TDifferenceReader {
  public:
    /// The arguments must outlive this. The inventories are those of the run, in its order.
    TDifferenceReader(const std::vector<TInventory>& inventories, TRules& rules) : fInventories(inventories), fRules(rules) {}

    /// The differences of all records, ordered by class name, then instance, then property.
    /// Errors: TZELException of a namespace; std::out_of_range if the records are not those of a run with these inventories.
    /// Cost: one key for each instance of a class with differences.
    std::vector<TDifference> Read(TDeltaNamespace& records);

  private:
    void StartClass(const std::string& className);
    TDifference Make(TDeltaRecord& record);
    boost::shared_ptr<ICIMInstance> FindByPath(const std::string& path);
    const TInstanceIndex& Index(std::size_t inventory);
    void AddKeys(TDifference& difference, const ICIMInstance& instance);
    void AddChange(TDifference& difference, std::string&& property, const ICIMInstance& reference);
    void AddDisagreements(TDifference& difference);
    TValueDifference::TEqual MakeEqual(const std::string& property) const;
    void CountSharing(TDifference& difference);

    const std::vector<TInventory>& fInventories;
    TRules& fRules;
    std::string fClassName;
    boost::shared_ptr<TInMemClass> fClass;                                     // the reference's
    bool fHasKeys = true;                                                      // of the class being read
    bool fExcludesKeys = false;                                                // likewise
    std::vector<std::string> fProperties;                                      // likewise; those compared, ascending
    boost::shared_ptr<ICIMClass> fKeysOf;                                      // the class of the instance read last
    std::vector<std::string> fKeys;                                            // its keys that are not excluded
    std::vector<std::unique_ptr<TInstanceIndex>> fIndexes;                     // of the class being read, made when first needed
    std::unordered_map<std::string, boost::shared_ptr<ICIMInstance>> fByPath;  // the reference's instances, likewise
};

}  // namespace NORVZEL20

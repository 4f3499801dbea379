#pragma once

#include <memory>
#include <string>
#include <vector>

#include "client/comparison/TDifference.h"
#include "client/comparison/TInstanceIndex.h"
#include "client/comparison/TValueGroups.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Turns records of a run into differences with values, which the records do not hold.
class TDifferenceReader {
  public:
    /// The arguments must outlive this. The inventories are those of the run, in its order.
    TDifferenceReader(const std::vector<TInventory>& inventories, TRules& rules) : fInventories(inventories), fRules(rules) {}

    /// From now on, all records are those of the class. Does nothing if it is that class already. Errors: TZELException of a
    /// namespace.
    void StartClass(const std::string& className);

    /// The difference that a record stands for. Errors: TZELException of a namespace; std::out_of_range if the record is not of a
    /// run with these inventories. Cost: the first one of a class takes one key for each instance of the class.
    TDifference Read(const ICIMInstance& record);

    /// The key of the instance that a record is about. Errors and cost: as for Read if it is a removed instance and the rules of
    /// the class exclude keys; otherwise the record has the key.
    TCIMValue KeyOf(const ICIMInstance& record);

    /// TDifference::CountInstances of the record of an added instance. Errors and cost: as for Read if the rules of the class
    /// exclude keys; otherwise it is 1.
    std::size_t CountInstances(const ICIMInstance& record);

  private:
    boost::shared_ptr<ICIMInstance> FindByPath(const std::string& path);
    TInstanceIndex& Index(std::size_t inventory);
    void AddKeys(TDifference& difference, const ICIMInstance& instance);
    void AddContents(TDifference& difference, const ICIMInstance& instance) const;
    void AddChange(TDifference& difference, const std::string& property, const ICIMInstance& reference);
    void AddDisagreements(TDifference& difference);
    TValueGroups MakeGroups(TValueDifference& difference) const;
    void CountSharing(TDifference& difference);

    const std::vector<TInventory>& fInventories;
    TRules& fRules;
    std::string fClassName;
    boost::shared_ptr<TInMemClass> fClass;                  // the reference's
    bool fHasKeys = true;                                   // of the class being read
    bool fExcludesKeys = false;                             // likewise
    std::vector<std::string> fProperties;                   // likewise; those compared, ascending
    std::vector<std::string> fContents;                     // the same without keys, in the order of the class
    boost::shared_ptr<ICIMClass> fKeysOf;                   // the class of the instance read last
    std::vector<std::string> fKeys;                         // its keys that are not excluded
    std::vector<std::unique_ptr<TInstanceIndex>> fIndexes;  // of the class being read, made when first needed
    std::unique_ptr<TInstanceIndex> fByPath;                // the reference's instances, likewise
};

}  // namespace NORVZEL20

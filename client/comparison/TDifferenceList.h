#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "client/comparison/IDifferences.h"
#include "client/comparison/ReadDeltaRecords.h"
#include "client/comparison/TDifferenceReader.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// The differences of a run. They are made from its records whenever they are read, one after the other: the list holds a pointer
/// for each and nothing else of them, and beside that an index of the instances of the class that is read (TInstanceIndex).
///
/// Threads: one at a time.
class TDifferenceList final : public IDifferences {
  public:
    /// `inventories` are those of the run, in its order; they must outlive this and not change meanwhile, and neither must the
    /// records. Errors: TZELException of a namespace; std::bad_alloc. Cost: the names in the records, in classes that exclude keys
    /// also one key for each instance.
    TDifferenceList(const std::vector<TInventory>& inventories, std::shared_ptr<TRules> rules, TDeltaNamespace& records);

    TDifferenceCounts GetCounts() const override { return fCounts; }

    /// Errors, beside those of IDifferences: std::out_of_range if the records are not those of a run with these inventories. Cost:
    /// one key for each instance of a class with differences, one more for each instance that differs.
    void ForEach(const TCallback& callback) override;

  private:
    // What decides the place of a record. The texts are those of the record, unless the rules exclude keys.
    struct TPlace {
        TCIMValue instance;
        TDeltaNamespace::EDeltaType type;
        TCIMValue property;
        boost::shared_ptr<ICIMInstance> record;
    };
    using TPlaces = std::vector<TPlace>;

    static bool StandsBefore(const TPlace& a, const TPlace& b);
    TPlaces FindPlaces(const TDeltaInstances& records);
    void Count(const TPlaces& places);

    const std::shared_ptr<TRules> fRules;
    TDifferenceReader fReader;
    std::map<std::string, TDeltaInstances> fClasses;  // the records in the order of the differences
    TDifferenceCounts fCounts;
};

}  // namespace NORVZEL20

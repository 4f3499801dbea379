#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/comparison/TDifference.h"
#include "client/comparison/TDifferenceCounter.h"
#include "client/findings/TPresencePlaces.h"
#include "client/findings/TShortNames.h"
#include "client/report/html/TPageChanges.h"
#include "client/report/html/TPageData.h"

namespace NORVZEL20 {

/// Gathers the differences of one class, which are added in the order of IDifferences, and writes them into the data of a page.
class TPageClassRows {
  public:
    /// The inventories that lack instances, by the key of the instance; see TDifference::instance.
    using TLacking = std::unordered_map<std::string, std::vector<std::size_t>>;

    /// `lacking` names those of instances whose absence the report leaves out. All must outlive this.
    TPageClassRows(const TComparisonReport& report, const TLacking& lacking, TShortNames& names, TPageData& data,
                   const std::string& className);

    const std::string& GetClassName() const { return fClass.name; }

    /// `number` is the difference's place among all.
    void Add(const TDifference& difference, std::size_t number);
    /// Writes the rows. Call it once, at the end.
    void Write();

  private:
    struct TRow {
        std::size_t instance;  // in fInstances
        std::uint32_t set;
        std::size_t content;  // of kChanged in TFinding::changes, otherwise the number that the page has for it
        std::size_t difference;
    };

    // One of the changes of a property.
    struct TChange {
        std::uint32_t number;  // that the page has for it
        std::size_t rows = 0;
        std::size_t fewest;  // how many inventories have the value that the fewest have, the reference's aside
    };

    struct TFinding {
        TPageFinding page;
        std::vector<std::size_t> inventories;  // ascending
        std::vector<TRow> rows;
        std::vector<TChange> changes;
        std::unordered_map<std::string, std::size_t> positions;  // in `changes`, by WholeText
    };

    struct TInstance {
        std::uint32_t name;
        std::uint32_t key;
        std::uint32_t lacking = 0;  // the set of the inventories that lack it
        std::uint32_t sharing = 0;
        std::uint32_t path = 0;
    };

    void Count(const TDifference& difference);
    void AddInstance(const TDifference& difference);
    void AddPresence(const TDifference& difference, std::size_t number);
    void AddChange(const TDifference& difference, const TValueDifference& change, std::size_t number);
    std::size_t AddContents(const TDifference& difference, TPageFinding::TExample& example);
    void AddDisagreements(const TDifference& difference);
    void AddRow(TFinding& finding, const TDifference& difference, const std::vector<std::size_t>& inventories, std::size_t content,
                std::size_t number);
    void WriteFinding(TFinding& finding, std::size_t firstInstance);
    const TValueWords& WordsFor(const std::string& property);
    std::size_t Rarity(const TFinding& finding) const;

    const TLacking& fLacking;
    TShortNames& fNames;
    TPageData& fData;
    TPageChanges fChanges;
    TPageClass fClass;
    TDifferenceCounter fCounter;
    const std::vector<TInventory>& fReportInventories;
    const std::size_t fInventories;
    std::map<std::string, TValueWords> fWords;  // by property
    std::vector<TFinding> fPresences;
    TPresencePlaces<> fPlaces;                                                         // in fPresences
    std::map<std::pair<std::string, std::vector<std::size_t>>, TFinding> fProperties;  // by name and inventories
    std::vector<TInstance> fInstances;
    std::string fInstance;       // the key of the last one
    std::vector<bool> fCounted;  // the inventories that are counted for it
    bool fHasInstance = false;
};

}  // namespace NORVZEL20

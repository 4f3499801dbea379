#pragma once

#include <memory>
#include <optional>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/inventory/TInventory.h"
#include "client/process/IConsole.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// One comparison of loaded inventories by the plug-in.
class TComparison {
  public:
    /// `inventories`, the reference first and at least two, and `console` must outlive this. The inventories may be changed: all
    /// of them by CompleteInventories and PutReferenceStandIns, and the reference by a run with exactly one other inventory, which
    /// brings it in line with that one unless the two have different types, keys or static values.
    TComparison(std::vector<TInventory>& inventories, IConsole& console) : fInventories(inventories), fConsole(console) {}

    /// Compares under `rules`, or without them every class in every property. With `strictSchema` the inventories are not
    /// completed first. Call this once. The differences of the report are valid while the inventories live.
    /// Errors: TClientError; std::bad_alloc.
    TComparisonReport Run(const std::optional<TRulesText>& rules, bool strictSchema);

  private:
    TComparisonReport RunWith(const std::shared_ptr<TRules>& rules, const TRulesText& text);
    std::vector<std::string> FindIdleRules(const TRulesDocument& document) const;
    void FindDifferences(TDeltaNamespace& records, TRules& rules);
    void RemoveMadeSystems(TDeltaNamespace& records);
    bool MustKeepReference() const;

    std::vector<TInventory>& fInventories;
    IConsole& fConsole;
    std::vector<TSchemaNote> fNotes;
    bool fStrictSchema = false;
};

}  // namespace NORVZEL20

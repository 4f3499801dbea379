#pragma once

#include <memory>
#include <optional>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/inventory/TInventory.h"
#include "client/process/IConsole.h"
#include "client/rules/TRules.h"
#include "client/rules/TRulesDraft.h"
#include "client/rules/TRulesText.h"
#include "client/rules/TSelection.h"

namespace NORVZEL20 {

/// One comparison of loaded inventories by the plug-in.
class TComparison {
  public:
    /// `inventories`, the reference first and at least two, and `console` must outlive this. The inventories may be changed: all
    /// of them by CompleteInventories and PutReferenceStandIns, and the reference by a run with exactly one other inventory, which
    /// brings it in line with that one unless the two have different types, keys or static values.
    TComparison(std::vector<TInventory>& inventories, IConsole& console) : fInventories(inventories), fConsole(console) {}

    /// Compares under `rules`, or without them every class in every property, and of that what `selection` names. With
    /// `strictSchema` the inventories are not completed first. Call this once. The differences of the report are valid while the
    /// inventories live. Errors: TClientError; std::bad_alloc.
    TComparisonReport Run(const std::optional<TRulesText>& rules, bool strictSchema, const TSelection& selection = TSelection());

    // The same in steps, for those who compare the same inventories several times.

    /// Completes the inventories and reads the rules. Call this once, before anything else. Errors: as for Run.
    void Prepare(const std::optional<TRulesText>& rules, bool strictSchema);
    /// What the rules that were prepared compare, to be changed.
    TRulesDraft MakeDraft();
    /// Compares under those rules if `changes` is null, otherwise under the changed ones. May be called several times, and never
    /// changes the reference. Errors: as for Run.
    TComparisonReport Try(const TRulesDraft* changes);

  private:
    TComparisonReport RunWith(const std::shared_ptr<TRules>& rules);
    std::vector<std::string> FindIdleRules(const TRulesDocument& document) const;
    void FindDifferences(TDeltaNamespace& records, TRules& rules);
    void RemoveMadeSystems(TDeltaNamespace& records);
    bool MustKeepReference() const;

    std::vector<TInventory>& fInventories;
    IConsole& fConsole;
    std::vector<TSchemaNote> fNotes;
    TRulesText fText;                // the rules as they were read or made
    std::shared_ptr<TRules> fRules;  // what they mean
    bool fStrictSchema = false;
    bool fKeepsReference = false;
};

}  // namespace NORVZEL20

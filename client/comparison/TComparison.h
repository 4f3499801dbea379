#pragma once

#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/inventory/TInventory.h"
#include "client/process/IConsole.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// One comparison of loaded inventories by the plug-in, from the schemas' completion to the report.
class TComparison {
  public:
    /// Everything must outlive this. The inventories are changed: by completion, and a pair's reference by the run itself.
    TComparison(std::vector<TInventory>& inventories, IConsole& console) : fInventories(inventories), fConsole(console) {}

    /// Compares everything as it is declared, or, with `rulesFile` not empty, as those rules say. With `strictSchema` the
    /// inventories are taken as they are, else they are completed first.
    /// Errors: TClientError; nothing is reported then.
    TComparisonReport Run(const std::string& rulesFile, bool strictSchema);

  private:
    TComparisonReport RunWith(const std::string& rulesFile, const std::string& shownName);
    void FindDifferences(TDeltaNamespace& records, TRules& rules);
    bool MustBeLeftAsItIs() const;

    std::vector<TInventory>& fInventories;
    IConsole& fConsole;
    std::vector<TSchemaNote> fNotes;
    bool fStrictSchema = false;
};

}  // namespace NORVZEL20

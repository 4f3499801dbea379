#pragma once

#include <string>
#include <vector>

#include "client/comparison/TCoverage.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRuleTrace.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Finds out what a comparison will look at. Use it before the run: a run over two inventories adds
/// instances to the first one.
class TCoverageBuilder {
  public:
    /// The arguments must outlive this. The inventories are those of the run, in its order.
    TCoverageBuilder(const std::vector<TInventory>& inventories, TRules& rules, const std::vector<TSchemaNote>& notes)
        : fInventories(inventories), fRules(rules), fTrace(rules.GetDocument(), inventories[0].ns), fNotes(notes)
    {}

    /// Errors: TZELException of a namespace; std::bad_alloc. Cost: with excluded keys, one key for each instance of the class.
    TCoverage Build();

  private:
    void AddClass(TCoverage& coverage, const std::string& className);
    void AddSuperClasses(TCoverage& coverage, const std::string& className) const;
    TCoverage::EState Describe(TCoverage::TClass& cls);
    TCoverage::EState WhyNothingIsCompared(const TCoverage::TClass& cls, const TInMemClass& declared) const;
    void CountCompared(TCoverage::TClass& cls) const;
    std::vector<TCoverage::TLeftOut> LeftOut(const TInMemClass& declared, const std::vector<std::string>& compared);
    TCoverage::EReason WhyLeftOut(const TInMemClass& declared, const std::string& property);
    bool IsUsedAsKey(const std::string& className, const std::string& property);
    std::vector<std::size_t> CountInstances(const std::string& className) const;

    const std::vector<TInventory>& fInventories;
    TRules& fRules;
    TRuleTrace fTrace;
    const std::vector<TSchemaNote>& fNotes;
};

}  // namespace NORVZEL20

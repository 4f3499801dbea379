#pragma once

#include <set>
#include <string>
#include <vector>

#include "client/comparison/TCoverage.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Finds out, before a comparison, what it will look at. (A comparison of two inventories adds instances to the first one.)
class TCoverageBuilder {
  public:
    /// Everything must outlive this.
    TCoverageBuilder(const std::vector<TInventory>& inventories, TRules& rules, const std::vector<TSchemaNote>& notes)
        : fInventories(inventories), fRules(rules), fNotes(notes)
    {}

    TCoverage Build();

  private:
    void AddClass(TCoverage& coverage, const std::string& className);
    void Describe(TCoverage::TClass& cls, const boost::shared_ptr<ICIMClass>& declared);
    std::vector<std::string> LeftOut(const std::string& className, const std::vector<std::string>& compared) const;
    std::vector<std::size_t> CountInstances(const std::string& className) const;
    bool IsMade(const std::string& className) const;

    const std::vector<TInventory>& fInventories;
    TRules& fRules;
    const std::vector<TSchemaNote>& fNotes;
};

}  // namespace NORVZEL20

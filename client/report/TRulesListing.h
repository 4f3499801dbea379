#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/rules/TRuleTrace.h"
#include "client/rules/TRules.h"
#include "client/rules/TRulesDocument.h"

namespace NORVZEL20 {

/// What `check` and `explain` report about a rules file.
class TRulesListing {
  public:
    /// Reads the rules; `schema` must outlive this. Errors: TClientError for a file that the plug-in does not accept.
    TRulesListing(const TRulesText& rules, const TInventory& schema);
    TRulesListing(const TRulesListing&) = delete;
    TRulesListing& operator=(const TRulesListing&) = delete;

    /// The elements with their lines, what follows from them for each class that has instances or an element, the elements whose
    /// classes have no instances, and warnings.
    std::string WriteCheck();

    /// How a class is treated, property by property. Errors: TClientError if it is not declared.
    std::string WriteExplanation(const std::string& className);
    /// How one property is treated. Errors: TClientError if the class or the property is not declared.
    std::string WriteExplanation(const std::string& className, const std::string& property);

  private:
    void WriteElements();
    void WriteEffective();
    void WriteEffective(const boost::shared_ptr<TInMemClass>& cls);
    void WriteUnmatched();
    void WriteWarnings();
    bool HasElement(const std::string& className) const;
    std::string Verdict(const TInMemClass& cls, const std::string& property, const std::vector<std::string>& compared);
    std::string Reason(const TInMemClass& cls, const std::string& property, bool isCompared) const;
    std::string Origin(const TRuleTrace::TDecision& decision) const;
    void AddLine(const std::string& text);

    const std::string fFile;
    const TInventory& fSchema;
    TRules fRules;
    const TRulesDocument& fDocument;
    const TRuleTrace fTrace;
    std::string fOut;
};

}  // namespace NORVZEL20

#pragma once

#include <set>
#include <string>
#include <vector>

#include "client/inventory/TInstanceCounts.h"
#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"
#include "client/rules/TRuleTrace.h"
#include "client/rules/TRuleWarnings.h"
#include "client/rules/TRules.h"
#include "client/rules/TRulesDocument.h"
#include "client/rules/TRulesText.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// What `check` and `explain` report about rules.
class TRulesListing {
  public:
    /// `inventories` are those that the rules are for, the reference first, and `notes` what was done to complete them; both must
    /// outlive this. With `strictSchema` they were left as they are. Without inventories every class and property that the rules
    /// name counts as declared. Errors: TClientError for rules that the plug-in does not accept.
    TRulesListing(const TRulesText& rules, const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes,
                  bool strictSchema);
    TRulesListing(const TRulesListing&) = delete;
    TRulesListing& operator=(const TRulesListing&) = delete;

    /// The elements with their lines, what follows from them for each class that has instances or an element, the elements whose
    /// classes have no instances, and warnings. Without inventories, the elements and those warnings that need none.
    std::string WriteCheck();

    /// How a class is treated, property by property; of the root class, which has none, what the rules say of it. There must be an
    /// inventory. Errors: TClientError if the reference does not declare the class.
    std::string WriteExplanation(const std::string& className);
    /// How one property is treated. There must be an inventory.
    /// Errors: TClientError if the reference does not declare the class or the property.
    std::string WriteExplanation(const std::string& className, const std::string& property);

  private:
    using TNames = std::set<std::string, TNameText::TLess>;

    // The references of a class that are compared although keys are excluded.
    struct TReduced {
        std::set<std::string> properties;
        std::string description;  // how they are compared; empty if there are none
    };

    void WriteElements();
    void WriteEffective(const TInstanceCounts& counts);
    void WriteEffective(const boost::shared_ptr<TInMemClass>& cls);
    void WriteUnmatched(const TInstanceCounts& counts);
    void WriteWarnings();
    std::string WriteRootExplanation();
    TNames ComparedIn(const boost::shared_ptr<TInMemClass>& cls);
    void AddVerdicts(const TInMemClass& cls, const TNames& compared);
    TReduced ReducedIn(const TInMemClass& cls) const;
    bool IsNeverCompared(const TInMemClass& cls) const;
    bool IsPartlyMade(const TInMemClass& cls) const;
    std::string SinceMade() const;
    std::string NotComparedWhereMade() const;
    bool HasElement(const std::string& className) const;
    std::vector<std::string> KeysLeftOut(const TInMemClass& cls);
    boost::shared_ptr<TInMemClass> RequireDeclared(const std::string& className) const;
    bool IsReferenceAlone() const;
    std::string PathsOfInventories() const;
    std::vector<std::string> PathsOf(const std::vector<std::size_t>& positions) const;
    std::string Verdict(const TInMemClass& cls, const std::string& property, const TNames& compared, const TReduced& reduced);
    std::string Reason(const TInMemClass& cls, const std::string& property, bool isCompared) const;
    std::string Origin(const TRuleTrace::TDecision& decision) const;
    void AddLine(const std::string& text);

    const TRulesText fText;
    const std::vector<TInventory>& fInventories;
    const std::vector<TSchemaNote>& fNotes;
    const bool fStrictSchema;
    const boost::shared_ptr<TInMemNamespace> fSchema;
    TRules fRules;
    const TRulesDocument& fDocument;
    const TRuleTrace fTrace;
    const TRuleWarnings fWarnings;
    const TNames fNamed;  // the classes that have an element
    std::string fOut;
};

}  // namespace NORVZEL20

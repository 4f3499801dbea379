#pragma once

#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/rules/TRuleTrace.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Rules that would leave findings of a report out.
class TRuleProposals {
  public:
    /// A piece of a specification file, and what to do with it.
    struct TProposal {
        std::string what;   ///< what it leaves out, one sentence
        std::string place;  ///< where it goes, one sentence
        std::string xml;
    };

    /// `report` must outlive this. Errors: those of TRules.
    explicit TRuleProposals(const TComparisonReport& report);

    /// Leaves out a property; of a path such as `Settings.Speed`, the first name. Each proposal is made once, which may parse all
    /// rules, and lives as long as this.
    const TProposal& LeaveOutProperty(const std::string& className, const std::string& path);
    /// Leaves out a whole class, because rules cannot leave out some of its instances.
    const TProposal& LeaveOutClass(const std::string& className);

  private:
    using TElements = std::vector<const TRulesDocument::TElement*>;

    TProposal ForProperty(const std::string& className, const std::string& property);
    TProposal ForClass(const std::string& className);
    TElements ElementsOf(const std::string& className) const;
    bool WouldLeaveOut(const std::string& className, const std::string& property, const std::string& element) const;
    std::string AtEnd() const;

    const TComparisonReport& fReport;
    const TRulesText fText;
    const boost::shared_ptr<TInMemNamespace> fSchema;
    std::unique_ptr<TRules> fRules;                                           // null if the person named no rules
    std::unique_ptr<TRuleTrace> fTrace;                                       // likewise
    std::map<std::pair<std::string, std::string>, TProposal> fForProperties;  // by class and property
    std::map<std::string, TProposal> fForClasses;
};

}  // namespace NORVZEL20

#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <unordered_map>
#include <vector>

#include "client/rules/TRuleMarks.h"
#include "client/rules/TRulesDocument.h"
#include "embedded/value/TNameText.h"
#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Which element of a rules file decides what, class by class. Threads: one at a time, also for operations that are const.
class TRuleTrace {
  public:
    /// A treatment and the element that gave it.
    struct TDecision {
        TCIMDiffEngine::propType treatment = TCIMDiffEngine::EXCLUDE;
        std::string fromClass;  ///< the class that the element is for; empty if no element reached the class
        unsigned int line = 0;  ///< the line of the element, or of the listed property
        bool isListed = false;  ///< whether a list names the property; otherwise the default decides
    };

    /// What holds for one class.
    struct TClass {
        TDecision byDefault;
        std::map<std::string, TDecision> listed;
        std::vector<std::string> excludedKeys;
        unsigned int excludedKeysLine = 0;
    };

    /// What an element found when it was merged.
    struct TArrival {
        std::optional<std::size_t> keys;      ///< the element that had already given the class its excluded keys
        std::optional<std::size_t> complete;  ///< the element after which the class's rules were final
    };

    /// `document` is what the plug-in accepted for `schema`; it must outlive this. Errors: those of the schema.
    TRuleTrace(const TRulesDocument& document, boost::shared_ptr<ICIMNamespace> schema);

    /// The class's entry; if no element reached it, one that excludes everything.
    TClass Find(const std::string& className) const { return Recall(className).rules; }

    /// What decides the property: its listing or the default. Cost: that of Find for the first property of a class, one look-up for
    /// each further one.
    TDecision Decide(const std::string& className, const std::string& property) const;

    /// The reference properties of the class that are compared although keys are excluded. The plug-in leaves the excluded keys of
    /// a class out of all references that its instances hold, whatever class they refer to, and the namespace too. It does not do
    /// so with a key that is not excluded: instances are matched by the whole reference.
    std::vector<std::string> FindReducedReferences(const ICIMClass& cls) const;

    /// The excluded keys of the class that references can lose, in the order of the rules: the keys of declared classes, and those
    /// that occur in references of the class's instances in the schema. A name that is neither changes no reference.
    /// Cost: one pass over those instances if an excluded key is not a key of any declared class.
    std::vector<std::string> FindKeysOfReferences(const std::string& className) const;

    /// The listing of a property that counts: the first one in the element at that position, which must list it.
    const TRulesDocument::TListed& GetListing(std::size_t index, const std::string& property) const
    {
        return *fListings[index].at(property);
    }

    /// How the element at that position found its class.
    const TArrival& GetArrival(std::size_t index) const { return fArrivals[index]; }

    /// Which elements decide what in the end.
    const TRuleMarks& GetMarks() const { return fMarks; }

  private:
    // The class asked for last; properties are asked for class by class.
    struct TRecalled {
        std::string className;
        TClass rules;
        TNameMap<const TDecision*> included;  // of rules.listed
    };

    void Merge(std::size_t index);
    TClass Make(const std::string& className) const;
    const TRecalled& Recall(const std::string& className) const;

    TDecision MakeDefault(std::size_t index) const;
    TDecision MakeListed(std::size_t index, const std::string& property) const;

    const std::vector<TRulesDocument::TElement>& fElements;
    boost::shared_ptr<ICIMNamespace> fSchema;
    TRuleMarks fMarks;
    std::vector<std::unordered_map<std::string, const TRulesDocument::TListed*>> fListings;  // one for each element
    std::set<std::string> fDeclaredKeys;                                                     // of all classes
    std::vector<TArrival> fArrivals;                                                         // one for each element
    std::map<std::string, std::size_t> fCompleting;  // the element after which the rules of each class are final
    mutable std::unique_ptr<TRecalled> fRecalled;
};

}  // namespace NORVZEL20

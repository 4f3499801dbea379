#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>
#include <vector>

#include "client/rules/TRuleMarks.h"
#include "client/rules/TRulesDocument.h"
#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Which element of a rules file decides what, class by class, and what in the file is probably a mistake.
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

    /// Something that is allowed but probably a mistake.
    struct TWarning {
        std::size_t element;  ///< the position of the element that it is about
        unsigned int line;
        std::string text;
    };

    /// `document` is what the plug-in accepted for `schema`; it must outlive this. Errors: those of the schema.
    TRuleTrace(const TRulesDocument& document, boost::shared_ptr<ICIMNamespace> schema);

    /// The class's entry; if no element reached it, one that excludes everything.
    TClass Find(const std::string& className) const;

    /// What decides the property: its listing or the default.
    TDecision Decide(const std::string& className, const std::string& property) const;

    /// The reference properties of the class that are compared although keys are excluded. The plug-in leaves the excluded keys of
    /// a class out of all references that its instances hold, whatever class they refer to, and the namespace too.
    std::vector<std::string> FindReducedReferences(const ICIMClass& cls) const;

    /// In the order of the elements that they are about, then of their lines.
    const std::vector<TWarning>& GetWarnings() const { return fWarnings; }

  private:
    void Apply(std::size_t index);
    void WarnOfLateness(std::size_t index);
    void WarnOfOverruled(std::size_t index);
    void CheckNames(std::size_t index);
    void CheckKeys(std::size_t index, const boost::shared_ptr<ICIMClass>& cls);
    void WarnOfReducedReferences();
    void Warn(std::size_t index, unsigned int line, const std::string& text);

    TDecision MakeDefault(std::size_t index) const;
    TDecision MakeListed(std::size_t index, const std::string& property) const;
    std::string LineOf(std::size_t index) const;

    const std::vector<TRulesDocument::TElement>& fElements;
    boost::shared_ptr<ICIMNamespace> fSchema;
    TRuleMarks fMarks;
    std::map<std::string, std::size_t> fFirst;  // the first element for each class, of those applied
    std::vector<TWarning> fWarnings;
};

}  // namespace NORVZEL20

#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>
#include <vector>

#include "client/rules/TRulesDocument.h"
#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Which element of a rules file decides what, class by class.
///
/// Repeats the plug-in's merging (an element merges into what its class has, then flows down to all subclasses) and notes the
/// origin of each treatment on the way. The treatments themselves are the plug-in's; this only explains them.
class TRuleTrace {
  public:
    /// A treatment and the element that gave it.
    struct TDecision {
        TCIMDiffEngine::propType treatment = TCIMDiffEngine::EXCLUDE;
        std::string fromClass;  ///< the class that the element is for; empty where no element reached the class
        unsigned int line = 0;  ///< the line of the element, or of the listed property
        bool isListed = false;  ///< whether a list names the property, or else the default decides
    };

    /// What holds for one class.
    struct TClass {
        TDecision byDefault;
        std::map<std::string, TDecision> listed;
        std::vector<std::string> excludedKeys;
        unsigned int excludedKeysLine = 0;
        bool isFinal = false;
    };

    /// Something that the rules allow and that their author hardly means.
    struct TWarning {
        unsigned int line;
        std::string text;
    };

    TRuleTrace(const TRulesDocument& document, boost::shared_ptr<ICIMNamespace> schema);

    /// The class's entry; one that excludes everything, from nowhere, where no element reached it.
    TClass Find(const std::string& className) const;

    /// What decides the property: its own listing or the default.
    TDecision Decide(const std::string& className, const std::string& property) const;

    /// In ascending order of their lines.
    const std::vector<TWarning>& GetWarnings() const { return fWarnings; }

  private:
    void Apply(const TRulesDocument::TElement& element);
    void MergeOwn(TClass& entry, const TRulesDocument::TElement& element);
    void PushDown(const std::string& className, const TRulesDocument::TElement& origin);
    void Inherit(const std::string& className, const TClass& parent, const TRulesDocument::TElement& origin);
    void CheckNames(const TRulesDocument::TElement& element);
    void CheckKeys(const TRulesDocument::TElement& element, ICIMClass& cls);
    void Warn(unsigned int line, const std::string& text);

    boost::shared_ptr<ICIMNamespace> fSchema;
    std::map<std::string, TClass> fClasses;
    std::map<std::string, unsigned int> fOwnLines;  // the first own element of each class
    std::vector<TWarning> fWarnings;
};

}  // namespace NORVZEL20

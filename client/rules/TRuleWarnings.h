#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/rules/TRuleTrace.h"
#include "client/rules/TRulesDocument.h"
#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// What rules allow but an author hardly means.
class TRuleWarnings {
  public:
    /// One warning.
    struct TWarning {
        std::size_t element;  ///< the position of the element that it is about; 0 if it is about the whole file
        unsigned int line;
        std::string text;
    };

    /// `trace` is that of `document`, which the plug-in accepted for `schema`; all must outlive this. If the schema is not known,
    /// it declares what the rules name, and nothing is said that depends on declarations. Errors: those of the schema.
    TRuleWarnings(const TRulesDocument& document, const TRuleTrace& trace, boost::shared_ptr<ICIMNamespace> schema,
                  bool isSchemaKnown);

    /// In the order of the elements that they are about, then of their lines.
    const std::vector<TWarning>& Get() const { return fWarnings; }

  private:
    void Check(std::size_t index);
    void CheckNames(std::size_t index, const ICIMClass& cls);
    void CheckRepetition(std::size_t index);
    void CheckKeys(std::size_t index, const boost::shared_ptr<ICIMClass>& cls);
    void WarnOfLateKeys(std::size_t index, std::size_t earlier);
    void CheckOverruled(std::size_t index);
    void CheckDefault(std::size_t index);
    void CheckCollectionTime(std::size_t index);
    void CheckThatAnythingIsIncluded();
    void CheckReferences();
    void CheckRecordClasses();
    void Warn(std::size_t index, unsigned int line, const std::string& text);

    std::string LineOf(std::size_t index) const;

    const std::vector<TRulesDocument::TElement>& fElements;
    const TRuleTrace& fTrace;
    const TRuleMarks& fMarks;
    boost::shared_ptr<ICIMNamespace> fSchema;
    bool fIsSchemaKnown;
    std::vector<TWarning> fWarnings;
};

}  // namespace NORVZEL20

#pragma once

#include <map>
#include <string>

#include "client/rules/TRulesDocument.h"
#include "client/rules/TRulesFault.h"
#include "client/rules/TRulesText.h"
#include "spec/TDiffXMLParser.h"

namespace NORVZEL20 {

/// The plug-in's parser, which also notes what it reads, with the lines.
///
/// The plug-in's operations decide everything: what they accept is noted in the document, what they refuse is the fault. The
/// plug-in logs each fault as usual. Use it for one document, from one thread.
class TRulesParser : public TCIMDiffEngine::TDiffXMLParser {
  public:
    explicit TRulesParser(boost::shared_ptr<ICIMNamespace> schema);

    void StartElement(const char* name, std::map<std::string, std::string>& attrs) override;
    void EndElement(const char* name) override;
    [[noreturn]] void FatalError(const char* message) override;

    /// Reads the whole document. Errors: TClientError that says what is wrong, where, and what can be done.
    void Read(const TRulesText& rules);

    /// What has been accepted so far.
    const TRulesDocument& GetDocument() const { return fDocument; }
    /// Why the parse ended with TZELException; without meaning otherwise.
    const TRulesFault& GetFault() const { return fFault; }

  protected:
    /// Whether the element in progress is DifftoolSpec.
    bool IsInRoot() const;
    /// Whether the element in progress is a property's name.
    bool IsInValue() const;

  private:
    void NoteStart(const std::string& name, bool hasDefault);
    void NoteFault(const char* reason, const TRulesFault& fault);

    TRulesDocument fDocument;
    TRulesFault fFault;
    TCIMDiffEngine::propType fTreatment = TCIMDiffEngine::EXCLUDE;  // of the list in progress
};

}  // namespace NORVZEL20

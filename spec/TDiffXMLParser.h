#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <deque>
#include <map>
#include <string>

#include "engine/TCIMDiffEngine.h"
#include "host/TXmlParser.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

/// Reads a specification into a ruleset. The order of the virtual operations is part of the contract.
///
///     DifftoolSpec  (version)                      TStateDTS
///       class*      (name, default, excludekeys)   TStateClass
///         includelist* | excludelist*              TStateIncludeList, TStateExcludeList
///           value*  a property's name              TStateValue
///
/// A stack holds one state for each open element, above TStateStart for the document itself. The state on top takes the next
/// tag: a start tag that it accepts pushes a state, an end tag pops one. End tags are not compared with what is open. Each class
/// and property is validated against a schema as it is read. The first error ends the parse and is thrown as TZELException. What
/// the grammar or the schema does not know is logged twice, once with the detail and once with the tag's line; malformed XML and
/// any other failure of the schema once. Exceptions of other types pass through unlogged.
///
/// For one document; one thread.
class TCIMDiffEngine::TDiffXMLParser : public TXmlParser {
  public:
    class TParseState;        // spec/TParseState.h
    class TStateStart;        // spec/TStateStart.h: nothing read yet
    class TStateDTS;          // spec/TStateDTS.h: in DifftoolSpec
    class TStateClass;        // spec/TStateClass.h: in class
    class TStateIncludeList;  // spec/TStateIncludeList.h: in includelist
    class TStateExcludeList;  // spec/TStateExcludeList.h: in excludelist
    class TStateValue;        // spec/TStateValue.h: in value

    /// A parser without rules, at the start of a document. A null `schema` fails the host's assertion at the first class.
    explicit TDiffXMLParser(boost::shared_ptr<ICIMNamespace> schema);
    ~TDiffXMLParser() override;

    /// Hands the tag to the state on top. Errors: status 9 for what the grammar or the schema does not know, any other status of
    /// the schema; each logged with the line.
    void StartElement(const char* name, std::map<std::string, std::string>& attrs) override;
    void EndElement(const char* name) override;
    /// Ignored.
    void processingInstruction(const char* target, const char* data) override;
    /// Collects `text` up to its first NUL; `length` is not used.
    void characters(const char* text, unsigned int length) override;
    /// Ignored.
    void notationDecl(const char* name, const char* publicId, const char* systemId) override;
    /// Logs the message with the line and throws status 9.
    [[noreturn]] void FatalError(const char* message) override;

    /// The rules of the classes closed so far; the copy shares them.
    TRuleset getRuleset();

  private:
    friend struct TTestAccess;

    [[noreturn]] void PassOn(const char* event, const TZELException& error);

    TRuleset fRuleset;

  protected:
    boost::shared_ptr<TDiffClassRules> fCurrentRules;        ///< of the class being read; null before the first
    std::deque<boost::shared_ptr<TParseState>> fStateStack;  ///< the states, that of the document first
    std::string fCharData;                                   ///< the text collected since a "value" began or ended

  private:
    boost::shared_ptr<ICIMNamespace> fSchema;
};

}  // namespace NORVZEL20

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
/// Elements, their attributes and the states that read them:
///
///     DifftoolSpec  (version)                      TStateDTS
///       class*      (name, default, excludekeys)   TStateClass
///         includelist* | excludelist*              TStateIncludeList, TStateExcludeList
///           value*  a property's name              TStateValue
///
/// A stack holds one state for each open element. TStateStart, for the document itself, is at the bottom. The state on top handles
/// the next tag: it pushes the state of a child element that it accepts, and pops itself at an end tag. The names of end tags are
/// not checked. Each class and property is looked up in a schema as it is read.
///
/// The first error ends the parse and is thrown as TZELException. An element, attribute, class or property that the grammar or the
/// schema does not know is logged twice, first in detail and then with the line of the tag. Malformed XML and any other status of
/// the schema are logged once. Exceptions of other types pass through unlogged.
///
/// Use a parser for one document, from one thread.
class TCIMDiffEngine::TDiffXMLParser : public TXmlParser {
  public:
    class TParseState;        // spec/TParseState.h
    class TStateStart;        // spec/TStateStart.h: nothing read yet
    class TStateDTS;          // spec/TStateDTS.h: in DifftoolSpec
    class TStateClass;        // spec/TStateClass.h: in class
    class TStateIncludeList;  // spec/TStateIncludeList.h: in includelist
    class TStateExcludeList;  // spec/TStateExcludeList.h: in excludelist
    class TStateValue;        // spec/TStateValue.h: in value

    /// A parser at the start of a document, without rules. A null `schema` fails the host's assertion at the first class.
    explicit TDiffXMLParser(boost::shared_ptr<ICIMNamespace> schema);
    ~TDiffXMLParser() override;

    /// Both pass the tag to the state on top. Errors, which are logged with the line: kParseError (9) if the grammar or the schema
    /// does not know what the tag names; any other status of the schema.
    void StartElement(const char* name, std::map<std::string, std::string>& attrs) override;
    void EndElement(const char* name) override;
    /// Ignored.
    void processingInstruction(const char* target, const char* data) override;
    /// Appends `text`, up to its first NUL, to the text collected so far. `length` is not used.
    void characters(const char* text, unsigned int length) override;
    /// Ignored.
    void notationDecl(const char* name, const char* publicId, const char* systemId) override;
    /// Logs the message with the line. Errors: kParseError (9), always.
    [[noreturn]] void FatalError(const char* message) override;

    /// The rules of all classes whose end tag was read. The copy shares them with the parser.
    TRuleset getRuleset();

  private:
    friend struct TTestAccess;

    [[noreturn]] void PassOn(const char* event, const TZELException& error);

    TRuleset fRuleset;

  protected:
    // For parsers that derive from this one and note what is read. Such a parser reads these members but does not change them.
    boost::shared_ptr<TDiffClassRules> fCurrentRules;  ///< of the class that is read now or was read last; null before the first
    std::deque<boost::shared_ptr<TParseState>> fStateStack;  ///< the states, that of the document first
    std::string fCharData;                                   ///< the text collected since a "value" began or ended

  private:
    boost::shared_ptr<ICIMNamespace> fSchema;
};

}  // namespace NORVZEL20

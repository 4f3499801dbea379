#include "spec/TDiffXMLParser.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "engine/TMessageStream.h"
#include "host/TRootObject.h"
#include "spec/TStateStart.h"

// The XML library calls StartElement, EndElement and characters; each passes the event to the state on top of the stack (see
// TParseState.cpp). An error on the way takes one of two paths:
//
//     FatalError   the grammar or the schema does not know a name, or the XML is malformed: logs the reason and throws
//     PassOn       the exception of a state, FatalError's among them, or of the schema: logs the tag's kind and line, throws again
//
// So a wrong name is logged twice, first with its reason and then with its tag. Malformed XML reaches FatalError directly.

namespace NORVZEL20 {

TCIMDiffEngine::TDiffXMLParser::TDiffXMLParser(boost::shared_ptr<ICIMNamespace> schema) : fSchema(std::move(schema))
{
    fStateStack.push_back(boost::make_shared<TStateStart>());
}

TCIMDiffEngine::TDiffXMLParser::~TDiffXMLParser() = default;

void TCIMDiffEngine::TDiffXMLParser::StartElement(const char* name, std::map<std::string, std::string>& attrs)
{
    const boost::shared_ptr<TParseState> state = fStateStack.back();
    try {
        std::string element(name);
        state->StartElement(*this, element, attrs);
    } catch (const TZELException& error) {
        PassOn("TDiffXMLParser: Thrown exception in StartElement ", error);
    }
}

void TCIMDiffEngine::TDiffXMLParser::EndElement(const char* name)
{
    // The state pops itself. Without this pointer it would be destroyed while it runs.
    const boost::shared_ptr<TParseState> state = fStateStack.back();
    try {
        std::string element(name);
        state->EndElement(*this, element);
    } catch (const TZELException& error) {
        PassOn("TDiffXMLParser: Threw exception in EndElement", error);
    }
}

void TCIMDiffEngine::TDiffXMLParser::processingInstruction(const char*, const char*) {}

void TCIMDiffEngine::TDiffXMLParser::characters(const char* text, unsigned int)
{
    fCharData += text;
}

void TCIMDiffEngine::TDiffXMLParser::notationDecl(const char*, const char*, const char*) {}

void TCIMDiffEngine::TDiffXMLParser::FatalError(const char* message)
{
    TMessageStream text;
    text << "Diff-XML Parser line " << GetCurLine() << ":" << message;
    TRootObject::GetCoreLogger()->Log(0, text.str());
    throw TZELException(TZELStatusCode::kParseError);
}

TCIMDiffEngine::TRuleset TCIMDiffEngine::TDiffXMLParser::getRuleset()
{
    return fRuleset;
}

void TCIMDiffEngine::TDiffXMLParser::PassOn(const char* event, const TZELException& error)
{
    TMessageStream text;
    text << event << error.what() << " on line " << GetCurLine();
    TRootObject::GetCoreLogger()->Log(0, text.str());
    throw TZELException(error.GetStatusCode());
}

}  // namespace NORVZEL20

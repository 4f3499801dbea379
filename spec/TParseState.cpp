#include "spec/TParseState.h"

#include <utility>

#include "engine/TMessageStream.h"

// A document is read by one state object for each open element. They are on a stack:
//
//     (document)     TStateStart
//     DifftoolSpec   TStateDTS
//     class          TStateClass
//     includelist    TStateIncludeList
//     value          TStateValue         <- top
//
// Only the state on top sees a tag. At a start tag it pushes the state of the child, which then reads the attributes. At an end tag
// it pops itself. There are two exceptions: TStateDTS does not pop itself, because the document ends there; and TStateValue pushes
// nothing, so the end tag of an element inside a value already ends the value.
//
// Every error ends in TDiffXMLParser::FatalError, which logs it with the line and throws.

namespace NORVZEL20 {

TCIMDiffEngine::TDiffXMLParser::TParseState::~TParseState() = default;

void TCIMDiffEngine::TDiffXMLParser::TParseState::StartElement(TDiffXMLParser&, std::string&, std::map<std::string, std::string>&)
{}

void TCIMDiffEngine::TDiffXMLParser::TParseState::EndElement(TDiffXMLParser& parser, std::string&)
{
    parser.fStateStack.pop_back();
}

void TCIMDiffEngine::TDiffXMLParser::TParseState::HandleAttrs(TDiffXMLParser&, std::map<std::string, std::string>&) {}

void TCIMDiffEngine::TDiffXMLParser::TParseState::Push(TDiffXMLParser& parser, boost::shared_ptr<TParseState> state)
{
    parser.fStateStack.push_back(std::move(state));
}

void TCIMDiffEngine::TDiffXMLParser::TParseState::Unexpected(TDiffXMLParser& parser, const std::string& name)
{
    parser.FatalError(("Unexpected element " + name).c_str());
    throw TZELException(
        TZELStatusCode::kParseError);  // FatalError always throws, but the compiler does not know it of a virtual call
}

void TCIMDiffEngine::TDiffXMLParser::TParseState::HandleAttrsOfTop(TDiffXMLParser& parser,
                                                                   std::map<std::string, std::string>& attrs)
{
    parser.fStateStack.back()->HandleAttrs(parser, attrs);
}

void TCIMDiffEngine::TDiffXMLParser::TParseState::FailOnLine(TDiffXMLParser& parser, const std::string& what,
                                                             const std::string& then)
{
    TMessageStream text;
    text << what << parser.GetCurLine() << then << std::endl;
    parser.FatalError(text.str().c_str());
    throw TZELException(TZELStatusCode::kParseError);  // as in Unexpected
}

}  // namespace NORVZEL20

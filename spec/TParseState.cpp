#include "spec/TParseState.h"

#include <utility>

#include "engine/TMessageStream.h"

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
}

}  // namespace NORVZEL20

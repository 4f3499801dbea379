#include "spec/TStateClass.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "spec/TDiffClassRules.h"
#include "spec/TStateExcludeList.h"
#include "spec/TStateIncludeList.h"

namespace NORVZEL20 {

void TCIMDiffEngine::TDiffXMLParser::TStateClass::StartElement(TDiffXMLParser& parser, std::string& name,
                                                               std::map<std::string, std::string>& attrs)
{
    if (name == "includelist") {
        Push(parser, boost::make_shared<TStateIncludeList>());
    } else if (name == "excludelist") {
        Push(parser, boost::make_shared<TStateExcludeList>());
    } else {
        Unexpected(parser, name);
    }
    HandleAttrsOfTop(parser, attrs);
}

void TCIMDiffEngine::TDiffXMLParser::TStateClass::EndElement(TDiffXMLParser& parser, std::string& name)
{
    // The class first, because its subclasses get the rules that result from this merge.
    parser.fRuleset.addToRuleset(fClassName, parser.fCurrentRules, true);
    parser.fRuleset.updateRuleset(fClassName, "", parser.fSchema);
    TParseState::EndElement(parser, name);
}

void TCIMDiffEngine::TDiffXMLParser::TStateClass::HandleAttrs(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs)
{
    parser.fCurrentRules = boost::make_shared<TDiffClassRules>();
    // The map orders the attributes by name, so the first error in that order is the one that is reported.
    for (const auto& [name, value] : attrs) {
        HandleAttr(parser, name, value);
    }
    // Checked after all attributes, because a wrong attribute is reported before a missing name.
    if (fClassName.empty()) {
        FailOnLine(parser, "Class specified on line ", "has no name");
    }
    ValidateClass(parser);
}

void TCIMDiffEngine::TDiffXMLParser::TStateClass::HandleAttr(TDiffXMLParser& parser, const std::string& name,
                                                             const std::string& value)
{
    if (name == "name") {
        fClassName = value;
        parser.fCurrentRules->fClassName = value;
    } else if (name == "default") {
        if (value != "include" && value != "exclude") {
            FailOnLine(parser, "Invalid default specified on line ");
        }
        parser.fCurrentRules->fDefault = value == "include" ? INCLUDE : EXCLUDE;
    } else if (name == "excludekeys") {
        parser.fCurrentRules->excludeKeys(value);
    } else {
        FailOnLine(parser, "Unknown parameter specified on line ");
    }
}

void TCIMDiffEngine::TDiffXMLParser::TStateClass::ValidateClass(TDiffXMLParser& parser) const
{
    try {
        parser.fSchema->GetClass(fClassName, TCallContext());
    } catch (const TZELException& error) {
        if (error.GetStatusCode() == TZELStatusCode::kNotFound) {
            FailOnLine(parser, "Class specified on line ", " was not found in the schema");
        }
        throw TZELException(error.GetStatusCode());
    }
}

}  // namespace NORVZEL20

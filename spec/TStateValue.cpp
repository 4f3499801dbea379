#include "spec/TStateValue.h"

#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

TCIMDiffEngine::TDiffXMLParser::TStateValue::TStateValue(TDiffXMLParser& parser, propType type) : fType(type)
{
    parser.fCharData.clear();
}

void TCIMDiffEngine::TDiffXMLParser::TStateValue::EndElement(TDiffXMLParser& parser, std::string& name)
{
    fValue = parser.fCharData;
    parser.fCharData.clear();
    ValidateProperty(parser);
    // Does nothing if the class lists the property already.
    parser.fCurrentRules->fProperties.emplace(fValue, fType);
    TParseState::EndElement(parser, name);
}

void TCIMDiffEngine::TDiffXMLParser::TStateValue::ValidateProperty(TDiffXMLParser& parser) const
{
    try {
        parser.fSchema->GetClass(parser.fCurrentRules->fClassName, TCallContext())->GetPropertyDecl(fValue, TCallContext());
    } catch (const TZELException& error) {
        if (error.GetStatusCode() == TZELStatusCode::kNotFound) {
            FailOnLine(parser, "Invalid property \"" + fValue + "\" specified on line ");
        }
        throw TZELException(error.GetStatusCode());
    }
}

}  // namespace NORVZEL20

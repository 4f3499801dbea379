#pragma once

#include "spec/TParseState.h"

namespace NORVZEL20 {

/// In "value": its text is the name of a property. A start tag within it is ignored, but the matching end tag ends the value.
class TCIMDiffEngine::TDiffXMLParser::TStateValue : public TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    /// Discards the text that the parser has collected so far.
    TStateValue(TDiffXMLParser& parser, propType type);

    /// Looks the property up in the schema and adds it to the rules. If the class lists it already, the first listing stays.
    void EndElement(TDiffXMLParser& parser, std::string& name) override;

  private:
    friend struct TTestAccess;

    void ValidateProperty(TDiffXMLParser& parser) const;

    std::string fValue;
    propType fType;
};

}  // namespace NORVZEL20

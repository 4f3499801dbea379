#pragma once

#include "spec/TParseState.h"

namespace NORVZEL20 {

/// In "value": its text is the name of a property. Elements within are ignored, but their end tag ends the value.
class TCIMDiffEngine::TDiffXMLParser::TStateValue : public TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    /// Forgets the text collected so far.
    TStateValue(TDiffXMLParser& parser, propType type);

    /// Looks the property up in the schema and lists it; what was listed first in a class stays.
    void EndElement(TDiffXMLParser& parser, std::string& name) override;

  private:
    friend struct TTestAccess;

    void ValidateProperty(TDiffXMLParser& parser) const;

    std::string fValue;
    propType fType;
};

}  // namespace NORVZEL20

#pragma once

#include "spec/TParseState.h"

namespace NORVZEL20 {

/// In "class": accepts "includelist" and "excludelist".
class TCIMDiffEngine::TDiffXMLParser::TStateClass : public TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    void StartElement(TDiffXMLParser& parser, std::string& name, std::map<std::string, std::string>& attrs) override;
    /// Adds the rules to the ruleset, for the class and for all its subclasses in the schema.
    void EndElement(TDiffXMLParser& parser, std::string& name) override;
    /// Starts new rules, reads "default", "excludekeys" and "name" in this order, and then looks the class up in the schema.
    void HandleAttrs(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs) override;

  private:
    friend struct TTestAccess;

    void HandleAttr(TDiffXMLParser& parser, const std::string& name, const std::string& value);
    void ValidateClass(TDiffXMLParser& parser) const;

    std::string fClassName;
};

}  // namespace NORVZEL20

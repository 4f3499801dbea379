#pragma once

#include "spec/TParseState.h"

namespace NORVZEL20 {

/// In "DifftoolSpec": accepts "class". It stays on the stack until the parser is destroyed.
class TCIMDiffEngine::TDiffXMLParser::TStateDTS : public TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    void StartElement(TDiffXMLParser& parser, std::string& name, std::map<std::string, std::string>& attrs) override;
    /// Does nothing: the state is not popped.
    void EndElement(TDiffXMLParser& parser, std::string& name) override;
    /// Accepts "version" with a value up to "1.0", compared as text. Any other attribute or value ends the parse.
    void HandleAttrs(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs) override;
};

}  // namespace NORVZEL20

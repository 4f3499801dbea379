#pragma once

#include "spec/TParseState.h"

namespace NORVZEL20 {

/// In "DifftoolSpec": accepts "class". Is never popped.
class TCIMDiffEngine::TDiffXMLParser::TStateDTS : public TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    void StartElement(TDiffXMLParser& parser, std::string& name, std::map<std::string, std::string>& attrs) override;
    /// Does nothing.
    void EndElement(TDiffXMLParser& parser, std::string& name) override;
    /// Accepts a version up to "1.0", compared as text, and nothing else.
    void HandleAttrs(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs) override;
};

}  // namespace NORVZEL20

#pragma once

#include "spec/TParseState.h"

namespace NORVZEL20 {

/// At the start of the document: accepts the root element "DifftoolSpec".
class TCIMDiffEngine::TDiffXMLParser::TStateStart : public TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    void StartElement(TDiffXMLParser& parser, std::string& name, std::map<std::string, std::string>& attrs) override;
};

}  // namespace NORVZEL20

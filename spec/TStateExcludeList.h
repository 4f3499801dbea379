#pragma once

#include "spec/TParseState.h"

namespace NORVZEL20 {

/// In "excludelist": accepts "value", which names a property to ignore.
class TCIMDiffEngine::TDiffXMLParser::TStateExcludeList : public TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    void StartElement(TDiffXMLParser& parser, std::string& name, std::map<std::string, std::string>& attrs) override;
};

}  // namespace NORVZEL20

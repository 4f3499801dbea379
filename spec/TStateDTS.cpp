#include "spec/TStateDTS.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "spec/TStateClass.h"

namespace NORVZEL20 {

void TCIMDiffEngine::TDiffXMLParser::TStateDTS::StartElement(TDiffXMLParser& parser, std::string& name,
                                                             std::map<std::string, std::string>& attrs)
{
    if (name != "class") {
        Unexpected(parser, name);
    }
    Push(parser, boost::make_shared<TStateClass>());
    HandleAttrsOfTop(parser, attrs);
}

void TCIMDiffEngine::TDiffXMLParser::TStateDTS::EndElement(TDiffXMLParser&, std::string&) {}

void TCIMDiffEngine::TDiffXMLParser::TStateDTS::HandleAttrs(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs)
{
    for (const auto& [name, value] : attrs) {
        // Compared as text: "1.0.0" is greater than "1.0", and "0.9" is not.
        if (name != "version" || value.compare("1.0") > 0) {
            parser.FatalError("Unknown TCIMDiffEngineSpec version");
        }
    }
}

}  // namespace NORVZEL20

#include "spec/TStateStart.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "spec/TStateDTS.h"

namespace NORVZEL20 {

void TCIMDiffEngine::TDiffXMLParser::TStateStart::StartElement(TDiffXMLParser& parser, std::string& name,
                                                               std::map<std::string, std::string>& attrs)
{
    if (name != "DifftoolSpec") {
        Unexpected(parser, name);
    }
    Push(parser, boost::make_shared<TStateDTS>());
    HandleAttrsOfTop(parser, attrs);
}

}  // namespace NORVZEL20

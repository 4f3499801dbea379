#include "spec/TStateIncludeList.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "spec/TStateValue.h"

namespace NORVZEL20 {

void TCIMDiffEngine::TDiffXMLParser::TStateIncludeList::StartElement(TDiffXMLParser& parser, std::string& name,
                                                                     std::map<std::string, std::string>& attrs)
{
    if (name != "value") {
        Unexpected(parser, name);
    }
    Push(parser, boost::make_shared<TStateValue>(parser, INCLUDE));
    HandleAttrsOfTop(parser, attrs);
}

}  // namespace NORVZEL20

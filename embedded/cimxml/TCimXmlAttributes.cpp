#include "embedded/cimxml/TCimXmlAttributes.h"

#include <string>

#include "embedded/load/MessageText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

TCIMValue::TCIMType TCimXmlAttributes::ReadType(const char* text) const
{
    const TCIMValue::TCIMType type = TValueText::FindType(text);
    if (type == TCIMValue::TCIMType::kNone) {
        fContext.Fail(TZELStatusCode::kParseError, "found type " + Quote(text) + ", expected a CIM type such as string or uint32");
    }
    return type;
}

void TCimXmlAttributes::FailMissing(const char* name) const
{
    fContext.Fail(TZELStatusCode::kParseError, std::string("found <") + TCimXmlElement::GetName(fElement) +
                                                   "> without the attribute " + name + ", expected it with a value");
}

}  // namespace NORVZEL20

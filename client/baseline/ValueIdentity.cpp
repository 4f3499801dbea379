#include "client/baseline/ValueIdentity.h"

#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"

namespace NORVZEL20 {

std::string ValueIdentity(const TCIMValue& value, bool isBag)
{
    if (value.IsNull()) {
        return "NULL";
    }
    std::string text;
    (isBag ? value.AsBag() : value).AppendKeyText(text);
    const std::string type = DescribeContents(value);
    // Quotes and backslashes have a backslash before them already, so escapes of control characters cannot be mistaken for text.
    return (type == "string" ? "" : type + " ") + EscapeForDisplay(text);
}

}  // namespace NORVZEL20

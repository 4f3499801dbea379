#include "client/text/InlineText.h"

#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"

namespace NORVZEL20 {

namespace {

bool HoldsMark(std::string_view text)
{
    if (text.find_first_of(",;={}()") != std::string_view::npos || text.find_first_of("+-:") == 0) {
        return true;
    }
    for (const char* const mark : {": ", "...", " and ", "   "}) {
        if (text.find(mark) != std::string_view::npos) {
            return true;
        }
    }
    return !text.empty() && text.back() == ':';
}

}  // namespace

std::string InlineText(const TCIMValue& value)
{
    const bool isText = value.GetType() == TCIMValue::TCIMType::kString && !value.IsNull() && !HasEmbeddedObject(value);
    return isText && HoldsMark(value.GetString()) ? QuoteForDisplay(value.GetString()) : DisplayContents(value);
}

}  // namespace NORVZEL20

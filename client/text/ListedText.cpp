#include "client/text/ListedText.h"

#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"

namespace NORVZEL20 {

std::string ListedText(const TCIMValue& value)
{
    if (value.IsNull() || HasEmbeddedObject(value)) {
        return DisplayContents(value);
    }
    if (value.GetType() == TCIMValue::TCIMType::kString) {
        const std::string_view text = value.GetString();
        return text.find_first_of(",{}") == std::string_view::npos ? DisplayValue(value) : QuoteForDisplay(text);
    }
    if (value.GetType() != TCIMValue::TCIMType::kArrayString) {
        return DisplayValue(value);
    }
    std::string list;
    for (const TCIMValue& element : value.GetElements()) {
        list += (list.empty() ? "" : ", ") + ListedText(element);
    }
    return "{" + list + "}";
}

}  // namespace NORVZEL20

#include "embedded/load/AsText.h"

#include <vector>

namespace NORVZEL20 {

TCIMValue AsText(const TCIMValue& value)
{
    if (!value.GetType().IsArray()) {
        return value.IsNull() ? TCIMValue::Null(TCIMValue::TCIMType::kString) : TCIMValue::FromText(value.ToText());
    }
    std::vector<TCIMValue> texts;
    for (const TCIMValue& element : value.GetElements()) {
        texts.push_back(AsText(element));
    }
    return TCIMValue(TCIMValue::TCIMType::kArrayString, static_cast<unsigned int>(texts.size()), texts);
}

}  // namespace NORVZEL20

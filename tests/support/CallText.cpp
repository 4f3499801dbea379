#include "tests/support/CallText.h"

namespace NORVZEL20 {

std::string ContextText(const TCallContext& context)
{
    std::string text;
    for (const auto& [name, value] : context) {
        text += (text.empty() ? "" : ", ") + name + "=" + ValueText(value);
    }
    return " {" + text + "}";
}

std::string Quoted(const std::string& text)
{
    return "\"" + text + "\"";
}

std::string ValueText(const TCIMValue& value)
{
    const bool isText = value.GetType() == TCIMValue::TCIMType::kString && !value.IsNull();
    return isText ? Quoted(value.ToText()) : value.ToText();
}

std::string FlagText(bool flag)
{
    return flag ? "true" : "false";
}

}  // namespace NORVZEL20

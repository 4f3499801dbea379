#include "tests/engine/NaiveText.h"

#include <algorithm>
#include <cctype>
#include <map>

namespace NORVZEL20 {

using EKind = TNaiveValue::EKind;

namespace {

std::string Escaped(const std::string& text)
{
    std::string result;
    for (const char c : text) {
        result += (c == '"' || c == '\\') ? std::string("\\") + c : std::string(1, c);
    }
    return "\"" + result + "\"";
}

std::string Lower(std::string text)
{
    std::transform(text.begin(), text.end(), text.begin(), [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

}  // namespace

std::string NaivePathText(const std::string& ns, const std::string& className,
                          const std::vector<std::pair<std::string, std::string>>& keys)
{
    std::map<std::string, std::string> sorted;
    for (const auto& [name, value] : keys) {
        sorted[Lower(name)] = name + "=" + value;
    }
    std::string text = (ns.empty() ? "" : ns + ":") + className;
    std::string separator = ".";
    for (const auto& [name, binding] : sorted) {
        text += separator + binding;
        separator = ",";
    }
    return text;
}

std::string NaivePathOf(const TNaiveValue& value, const TNaiveRules& rules)
{
    std::vector<std::pair<std::string, std::string>> keys;
    for (const auto& [name, key] : value.pathKeys) {
        if (!rules.IsExcludedKey(name)) {
            keys.emplace_back(name, Escaped(key));
        }
    }
    return NaivePathText(rules.excludedKeys.empty() && !value.list.empty() ? value.list[0] : "", value.text, keys);
}

std::string NaiveKeyText(const TNaiveValue& value)
{
    if (value.isNull) {
        return "NULL";
    }
    return value.kind == EKind::kNumber ? std::to_string(value.number) : Escaped(value.text);
}

std::string NaiveValueText(const TNaiveValue& value)
{
    if (value.isNull) {
        return "NULL";
    }
    if (value.kind == EKind::kNumber) {
        return std::to_string(value.number);
    }
    if (value.kind == EKind::kPath) {
        return NaivePathOf(value, TNaiveRules());
    }
    if (value.kind == EKind::kText) {
        return "\"" + value.text + "\"";
    }
    std::string text;
    for (const auto& element : value.list) {
        text += (text.empty() ? "" : ", ") + ("\"" + element + "\"");
    }
    return "{" + text + "}";
}

}  // namespace NORVZEL20

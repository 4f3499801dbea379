#include "tests/engine/NaiveText.h"

#include <algorithm>
#include <cctype>
#include <map>

#include "tests/engine/NaiveTime.h"

namespace NORVZEL20 {

using EKind = TNaiveValue::EKind;

namespace {

using TBindings = std::vector<std::pair<std::string, std::string>>;

std::string Quoted(const std::string& text, char quote)
{
    std::string result;
    for (const char c : text) {
        result += (c == quote || c == '\\') ? std::string("\\") + c : std::string(1, c);
    }
    return quote + result + quote;
}

std::string Lower(std::string text)
{
    std::transform(text.begin(), text.end(), text.begin(), [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

/// As character data of XML, with `quote` for each quotation mark.
std::string Escaped(const std::string& text, const std::string& quote = "&quot;")
{
    std::string result;
    for (const char c : text) {
        result += c == '<' ? "&lt;" : c == '&' ? "&amp;" : c == '"' ? quote : std::string(1, c);
    }
    return result;
}

std::string TypeName(const TNaiveValue& value)
{
    static const std::map<EKind, std::string> kNames = {
        {EKind::kUint32, "uint32"}, {EKind::kText, "string"}, {EKind::kTime, "datetime"}, {EKind::kReal32, "real32"}};
    return kNames.at(value.kind);
}

/// An embedded object in one order and spelling.
std::string ObjectText(const TNaiveValue& value)
{
    std::map<std::string, std::string> sorted;
    for (const auto& [name, member] : value.members) {
        if (!member.isNull) {
            const bool isTime = member.kind == EKind::kTime;
            const std::string shown = isTime ? NaiveUtcText(member.text) : member.text == "-0" ? "0" : member.text;
            sorted[Lower(name)] = "<PROPERTY NAME=\"" + Lower(name) + "\" TYPE=\"" + TypeName(member) + "\"><VALUE>" +
                                  Escaped(shown) + "</VALUE></PROPERTY>";
        }
    }
    std::string text = "<INSTANCE CLASSNAME=\"" + Lower(value.text) + "\">";
    for (const auto& [name, property] : sorted) {
        text += property;
    }
    return text + "</INSTANCE>";
}

/// An embedded object as CIM-XML, in the order and spelling in which it was written. Its reals are whole numbers.
std::string WrittenObject(const TNaiveValue& value)
{
    std::string text = "<INSTANCE CLASSNAME=\"" + value.text + "\">";
    for (const auto& [name, member] : value.members) {
        text += "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + TypeName(member) + "\">";
        const std::string shown = Escaped(member.text, "\"") + (member.kind == EKind::kReal32 ? ".0" : "");
        text += (member.isNull ? "" : "<VALUE>" + shown + "</VALUE>") + "</PROPERTY>";
    }
    return text + "</INSTANCE>";
}

std::string WrittenPath(const TNaiveValue& value)
{
    TBindings keys;
    for (const auto& [name, key] : value.members) {
        keys.emplace_back(name, NaiveWrittenKeyText(key));
    }
    return NaivePathText(value.list.empty() ? "" : value.list[0], value.text, keys);
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
    TBindings keys;
    for (const auto& key : value.members) {
        if (!rules.IsExcludedKey(key.name)) {
            keys.emplace_back(key.name, NaiveKeyText(key.value));
        }
    }
    return NaivePathText(rules.excludedKeys.empty() && !value.list.empty() ? Lower(value.list[0]) : "", value.text, keys);
}

std::string NaiveKeyText(const TNaiveValue& value)
{
    if (value.isNull) {
        return "NULL";
    }
    switch (value.kind) {
    case EKind::kText:
        return Quoted(value.text, '"');
    case EKind::kTime:
        return Quoted(NaiveUtcText(value.text), '"');
    case EKind::kChar:
        return Quoted(value.text, '\'');
    case EKind::kPath:
        return Quoted(NaivePathOf(value, TNaiveRules()), '"');
    case EKind::kObject:
        return Quoted(ObjectText(value), '"');
    default:
        return value.text == "-0" ? "0" : value.text;
    }
}

std::string NaiveWrittenKeyText(const TNaiveValue& value)
{
    if (value.isNull) {
        return "NULL";
    }
    switch (value.kind) {
    case EKind::kTime:
        return Quoted(value.text, '"');
    case EKind::kPath:
        return Quoted(WrittenPath(value), '"');
    case EKind::kObject:
        return Quoted(WrittenObject(value), '"');
    default:
        return NaiveKeyText(value);
    }
}

std::string NaiveValueText(const TNaiveValue& value)
{
    if (value.isNull) {
        return "NULL";
    }
    switch (value.kind) {
    case EKind::kPath:
        return WrittenPath(value);
    case EKind::kText:
        return "\"" + value.text + "\"";
    case EKind::kObject:
        return "\"" + WrittenObject(value) + "\"";
    case EKind::kList:
        break;
    default:
        return value.text;
    }
    std::string text;
    for (const auto& element : value.list) {
        text += (text.empty() ? "" : ", ") + ("\"" + element + "\"");
    }
    return "{" + text + "}";
}

}  // namespace NORVZEL20

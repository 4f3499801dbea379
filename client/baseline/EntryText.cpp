#include "client/baseline/EntryText.h"

#include "client/baseline/FindBadEscape.h"
#include "client/baseline/ForEachUnquoted.h"

namespace NORVZEL20 {

namespace {

// Whether the text is one field, and no mark.
bool IsField(const std::string& text)
{
    bool isWhole = !text.empty() && text.front() != '"' && text.front() != '\'' && text.back() != ',' && text != "in";
    int braces = 0;  // open ones: an array is one field
    const std::size_t open = ForEachUnquoted(text, [&](std::size_t at) {
        braces += text[at] == '{' ? 1 : text[at] == '}' ? -1 : 0;
        const bool isBlank = text[at] == ' ' || text[at] == '\t';
        return isWhole = isWhole && braces >= 0 && (!isBlank || braces > 0) && text[at] != '#';
    });
    return isWhole && braces == 0 && open == std::string_view::npos && FindBadEscape(text) == std::string_view::npos;
}

std::string QuotedField(const std::string& text)
{
    std::string quoted = "\"";
    for (const char character : text) {
        quoted.append(character == '"' || character == '\\' ? "\\" : "") += character;
    }
    return quoted + '"';
}

// `Version: "5.1" -> "5.2"`
std::string EntryValueText(const TAcceptedDifference::TValue& value)
{
    return value.property + ": " + (value.before.empty() ? "" : value.before + " -> ") + value.after;
}

}  // namespace

std::string FieldText(const std::string& text)
{
    return IsField(text) ? text : QuotedField(text);
}

const char* SignOf(TDifference::EKind kind)
{
    switch (kind) {
    case TDifference::kOnlyInReference:
        return "-";
    case TDifference::kOnlyInOthers:
        return "+";
    default:
        return "~";
    }
}

std::string EntryText(const TAcceptedDifference& entry)
{
    std::string text = std::string(SignOf(entry.kind)) + " " + entry.instance;
    for (std::size_t i = 0; i < entry.values.size(); ++i) {
        text += (i == 0 ? " " : ", ") + EntryValueText(entry.values[i]);
    }
    text += " in ";
    for (std::size_t i = 0; i < entry.inventories.size(); ++i) {
        const std::string& label = entry.inventories[i];
        text += (i == 0 ? "" : ", ") + (label.find_first_of(", \t") == std::string::npos ? FieldText(label) : QuotedField(label));
    }
    return text;
}

}  // namespace NORVZEL20

#include "client/report/TJsonDocument.h"

#include <utility>

#include "client/report/JsonValue.h"

namespace NORVZEL20 {

namespace {

// In the object, and in a list that is a member of it.
const char kMemberStart[] = "\n  ";
const char kElementStart[] = "\n    ";

// The text of a value within others: each line but the first begins like `start`. Texts in it have no line ends.
std::string Within(const char* start, const nlohmann::ordered_json& value)
{
    const std::string text = WriteJson(value, true);
    std::string indented;
    std::size_t begin = 0;
    for (std::size_t end = text.find('\n'); end + 1 < text.size(); end = text.find('\n', begin)) {
        indented.append(text, begin, end - begin).append(start);
        begin = end + 1;
    }
    return indented.append(text, begin, text.size() - 1 - begin);
}

}  // namespace

TJsonDocument::TJsonDocument(TTextSink sink, bool isIndented) : fSink(std::move(sink)), fIsIndented(isIndented)
{
    fSink("{");
}

void TJsonDocument::Add(const std::string& name, const nlohmann::ordered_json& value)
{
    fSink(MemberBegin(name) + Text(kMemberStart, value));
    fIsEmpty = false;
}

void TJsonDocument::StartList(const std::string& name)
{
    fSink(MemberBegin(name) + "[");
    fIsEmpty = false;
    fIsListEmpty = true;
}

void TJsonDocument::AddElement(const nlohmann::ordered_json& value)
{
    fSink((fIsListEmpty ? "" : ",") + Text(kElementStart, value));
    fIsListEmpty = false;
}

void TJsonDocument::EndList()
{
    fSink(fIsListEmpty || !fIsIndented ? "]" : kMemberStart + std::string("]"));
}

void TJsonDocument::End()
{
    fSink(fIsIndented ? "\n}\n" : "}\n");
}

// An element with its start, or a member's value, whose start stands before its name.
std::string TJsonDocument::Text(const char* start, const nlohmann::ordered_json& value) const
{
    if (!fIsIndented) {
        const std::string text = WriteJson(value, false);
        return text.substr(0, text.size() - 1);
    }
    return (start == kElementStart ? kElementStart : "") + Within(start, value);
}

std::string TJsonDocument::MemberBegin(const std::string& name) const
{
    return std::string(fIsEmpty ? "" : ",") + (fIsIndented ? kMemberStart : "") + "\"" + name + (fIsIndented ? "\": " : "\":");
}

}  // namespace NORVZEL20

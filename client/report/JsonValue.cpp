#include "client/report/JsonValue.h"

#include <cmath>
#include <map>
#include <utility>

#include "client/text/EmbeddedText.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

TJson JsonOfReal(const TCIMValue& value)
{
    const double real = value.GetReal();
    if (!std::isfinite(real)) {
        return value.ToText();
    }
    if (real == 0 && std::signbit(real)) {
        return TJson(real);  // as an integer, it would lose its sign
    }
    // The library writes the shortest text that gives a real64 back, for 0.1f that is 0.10000000149011612. ToText knows that the
    // value is a real32, and gives "0.1".
    return value.GetType() == TCIMValue::TCIMType::kReal32 ? TJson::parse(value.ToText(), nullptr, false) : TJson(real);
}

}  // namespace

nlohmann::ordered_json JsonOf(const TCIMValue& value)
{
    if (value.IsNull()) {
        return nullptr;
    }
    if (value.GetType().IsArray()) {
        TJson elements = TJson::array();
        for (const TCIMValue& element : value.GetElements()) {
            elements.push_back(JsonOf(element));
        }
        return elements;
    }
    switch (value.GetType()) {
    case TCIMValue::TCIMType::kBoolean:
        return value.GetBoolean();
    case TCIMValue::TCIMType::kUint8:
    case TCIMValue::TCIMType::kUint16:
    case TCIMValue::TCIMType::kUint32:
    case TCIMValue::TCIMType::kUint64:
        return value.GetUnsigned();
    case TCIMValue::TCIMType::kSint8:
    case TCIMValue::TCIMType::kSint16:
    case TCIMValue::TCIMType::kSint32:
    case TCIMValue::TCIMType::kSint64:
        return value.GetSigned();
    case TCIMValue::TCIMType::kReal32:
    case TCIMValue::TCIMType::kReal64:
        return JsonOfReal(value);
    default:
        return value.ToText();
    }
}

nlohmann::ordered_json ContentsOf(const TCIMValue& value)
{
    if (!HasEmbeddedObject(value)) {
        return nullptr;
    }
    if (value.GetType().IsArray()) {
        TJson elements = TJson::array();
        for (const TCIMValue& element : value.GetElements()) {
            elements.push_back(ContentsOf(element));
        }
        return elements;
    }
    const boost::shared_ptr<const TEmbeddedObject> object = value.GetEmbeddedObject();
    if (object->IsClass()) {
        return {{"classDeclaration", object->GetClassName()}};
    }
    std::map<std::string, TJson, TNameText::TLess> sorted;
    for (const TEmbeddedObject::TProperty& property : object->GetProperties()) {
        sorted[property.name] = HasEmbeddedObject(property.value) ? ContentsOf(property.value) : JsonOf(property.value);
    }
    TJson properties = TJson::object();
    for (const auto& [name, contents] : sorted) {
        properties[name] = contents;
    }
    return {{"class", object->GetClassName()}, {"properties", properties}};
}

nlohmann::ordered_json JsonWithType(const TCIMValue& value)
{
    TJson json = {{"type", TValueText::DescribeType(value.GetType())}, {"value", JsonOf(value)}};
    if (HasEmbeddedObject(value)) {
        json["embedded"] = ContentsOf(value);
    }
    return json;
}

// The list is made before it is added: nlohmann's push_back on a missing element first makes that element an array, and ends the
// process if there is no memory for it.
void AddJsonList(nlohmann::ordered_json& json, const char* name, nlohmann::ordered_json list)
{
    if (!list.empty()) {
        json[name] = std::move(list);
    }
}

std::string WriteJson(const nlohmann::ordered_json& document, bool indented)
{
    return document.dump(indented ? 2 : -1, ' ', false, TJson::error_handler_t::replace) + "\n";
}

}  // namespace NORVZEL20

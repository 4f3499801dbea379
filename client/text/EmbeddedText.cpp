#include "client/text/EmbeddedText.h"

#include <algorithm>
#include <map>

#include "client/text/DisplayText.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

// Text within braces is always quoted: it may hold a comma or a brace itself.
std::string DisplayWithin(const TCIMValue& value)
{
    const bool isText = !value.IsNull() && value.GetType() == TCIMValue::TCIMType::kString && !value.GetEmbeddedObject();
    return isText ? QuoteForDisplay(value.GetString()) : DisplayContents(value);
}

std::string DisplayInstance(const TEmbeddedObject& object)
{
    std::map<std::string, std::string, TNameText::TLess> properties;
    for (const TEmbeddedObject::TProperty& property : object.GetProperties()) {
        if (!property.value.IsNull()) {
            properties[property.name] = DisplayWithin(property.value);
        }
    }
    std::string text;
    for (const auto& [name, value] : properties) {
        text += (text.empty() ? "" : ", ") + EscapeForDisplay(name) + ": " + value;
    }
    return EscapeForDisplay(object.GetClassName()) + " {" + text + "}";
}

std::string DisplayElements(const TCIMValue& array)
{
    std::string text;
    for (const TCIMValue& element : array.GetElements()) {
        text += (text.empty() ? "" : ", ") + DisplayWithin(element);
    }
    return "{" + text + "}";
}

}  // namespace

std::string DisplayContents(const TCIMValue& value)
{
    if (!HasEmbeddedObject(value)) {
        return DisplayValue(value);
    }
    if (value.GetType().IsArray()) {
        return DisplayElements(value);
    }
    const boost::shared_ptr<const TEmbeddedObject> object = value.GetEmbeddedObject();
    return object->IsClass() ? DisplayValue(value) : DisplayInstance(*object);
}

std::string DescribeContents(const TCIMValue& value)
{
    if (!HasEmbeddedObject(value)) {
        return TValueText::DescribeType(value.GetType());
    }
    return value.GetType().IsArray() ? "embedded object[]" : "embedded object";
}

bool HasEmbeddedObject(const TCIMValue& value)
{
    if (value.IsNull() || value.GetType().GetElementType() != TCIMValue::TCIMType::kString) {
        return false;
    }
    if (!value.GetType().IsArray()) {
        return value.GetEmbeddedObject() != nullptr;
    }
    const std::vector<TCIMValue>& elements = value.GetElements();
    return std::any_of(elements.begin(), elements.end(), HasEmbeddedObject);
}

}  // namespace NORVZEL20

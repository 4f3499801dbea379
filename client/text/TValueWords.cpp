#include "client/text/TValueWords.h"

#include <vector>

#include "client/text/DisplayText.h"
#include "client/text/InlineText.h"
#include "client/text/ReadableTime.h"
#include "client/text/TextOfQualifier.h"

namespace NORVZEL20 {

namespace {

std::vector<std::string> TextsOfQualifier(const ICIMPropertyDecl& declaration, const char* name)
{
    const TCIMValue value = ValueOfQualifier(declaration, name);
    std::vector<std::string> texts;
    if (!value.IsNull() && value.GetType() == TCIMValue::TCIMType::kArrayString) {
        for (const TCIMValue& element : value.GetElements()) {
            texts.push_back(element.IsNull() ? std::string() : std::string(element.GetString()));
        }
    }
    return texts;
}

}  // namespace

TValueWords::TValueWords(const ICIMPropertyDecl& declaration)
    : fNames(TextsOfQualifier(declaration, "ValueMap"), TextsOfQualifier(declaration, "Values")),
      fUnit(TextOfQualifier(declaration, "PUnit"), TextOfQualifier(declaration, "Units"))
{}

std::string TValueWords::Describe(const TCIMValue& value) const
{
    if (value.IsNull()) {
        return std::string();
    }
    if (value.GetType().IsArray()) {
        return DescribeArray(value);
    }
    if (value.GetType() == TCIMValue::TCIMType::kDateTime) {
        return ReadableTime(value.ToText());
    }
    const std::string* const name = fNames.Find(value);
    return name == nullptr ? fUnit.Describe(value) : DisplayValue(value) + " " + InlineText(TCIMValue(*name));
}

// Empty if no element is to be written otherwise than it is.
std::string TValueWords::DescribeArray(const TCIMValue& value) const
{
    std::string text;
    bool isAny = false;
    for (const TCIMValue& element : value.GetElements()) {
        const std::string words = Describe(element);
        isAny = isAny || !words.empty();
        text += (text.empty() ? "" : ", ") + (words.empty() ? InlineText(element) : words);
    }
    return isAny ? "{" + text + "}" : std::string();
}

}  // namespace NORVZEL20

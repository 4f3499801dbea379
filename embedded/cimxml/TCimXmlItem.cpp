#include "embedded/cimxml/TCimXmlItem.h"

#include "embedded/cimxml/TCimXmlObjectReader.h"
#include "embedded/load/MessageText.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

void TCimXmlItem::BeginArray(bool isOfReferences)
{
    BeginValue();
    fElements.clear();
    if (isOfReferences && fType.GetElementType() != TType::kReference) {
        fContext.Fail(EStatus::kTypeMismatch, "found an array of references as value of " + Quote(fName) + ", expected a " +
                                                  TValueText::DescribeType(fType.GetArrayType()));
    }
}

/// Writers of qualifiers name the type of an element alone: that the value is an array shows only now.
void TCimXmlItem::EndArray()
{
    fType = fType.GetArrayType();
    fValue = TCIMValue(fType, static_cast<unsigned int>(fElements.size()), fElements);
    fElements.clear();
}

TCIMValue TCimXmlItem::Take()
{
    TCIMValue value = IsNull() ? TCIMValue::Null(fType) : std::move(fValue);
    fValue = TCIMValue();
    return value;
}

void TCimXmlItem::Parse(std::string_view text, TCIMValue& value)
{
    const TType type = fType.GetElementType();
    if (type == TType::kString) {
        value = IsObject(text) ? fObjects.Read(text) : fContext.GetTexts().MakeValue(text);
    } else if (!TValueText::Parse(type, text, value)) {
        fContext.Fail(EStatus::kTypeMismatch,
                      "found " + Quote(text) + " as value of " + Quote(fName) + ", expected a " + TValueText::GetTypeName(type));
    }
}

/// Without a mark in the document, the declaration allows plain text too, so the text itself has to decide.
bool TCimXmlItem::IsObject(std::string_view text) const
{
    if (fText == EValueText::kPerhapsObject) {
        return TEmbeddedObject::IsPerhapsText(text);
    }
    return fText == EValueText::kObject && !text.empty();
}

void TCimXmlItem::FailSecond() const
{
    fContext.Fail(EStatus::kParseError, "found a second value for " + Quote(fName) + ", expected one");
}

}  // namespace NORVZEL20

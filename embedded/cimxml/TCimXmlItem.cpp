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
    fMark = kNoMark;
    if (isOfReferences && fType.GetElementType() != TType::kReference) {
        fContext.Fail(EStatus::kTypeMismatch, "found an array of references as value of " + Quote(fName) + ", expected a " +
                                                  TValueText::DescribeType(fType.GetArrayType()));
    }
}

/// Writers of qualifiers name the type of an element alone: that the value is an array shows only now.
void TCimXmlItem::EndArray()
{
    fType = fType.GetArrayType();
    if (IsBad()) {
        return;  // TakeBad needs the elements
    }
    fValue = TCIMValue(fType, static_cast<unsigned int>(fElements.size()), fElements);
    fElements.clear();
}

TCIMValue TCimXmlItem::Take()
{
    if (IsBad()) {
        FailBad();
    }
    TCIMValue value = IsNull() ? TCIMValue::Null(fType) : std::move(fValue);
    fValue = TCIMValue();
    return value;
}

void TCimXmlItem::FailBad()
{
    const TBadValue bad = TakeBad();
    const TLoadContext::TAt at(fContext, bad.place);
    fContext.Fail(EStatus::kTypeMismatch, "found " + Quote(bad.text) + " as value of " + Quote(fName) + ", expected a " + bad.type);
}

void TCimXmlItem::Parse(std::string_view text, TCIMValue& value)
{
    const TType type = fType.GetElementType();
    if (type != TType::kString) {
        if (!TValueText::Parse(type, text, value)) {
            NoteBad(text, TValueText::GetTypeName(type));
        }
    } else if (IsObject(text)) {
        ReadObject(text, value);
    } else {
        value = fContext.GetTexts().MakeValue(text);
    }
}

void TCimXmlItem::NoteBad(std::string_view text, const char* type)
{
    const std::size_t position = fElements.empty() ? 0 : fElements.size() - 1;
    fBadTexts.push_back({position, std::string(text), type, fContext.GetPlace()});
}

/// What is wrong inside of the object is the message of a load that refuses it.
void TCimXmlItem::ReadObject(std::string_view text, TCIMValue& value)
{
    if (fContext.GetOptions().badValues == EBadValues::kRefuse) {
        value = fObjects.Read(text);
        return;
    }
    fMark = fMark == kNoMark ? fContext.GetBadValues().GetMark() : fMark;
    try {
        value = fObjects.Read(text);
    } catch (const TPopulateError& error) {
        if (!fContext.LetsPass(error)) {
            throw;
        }
        NoteBad(text, "class or instance");
    }
}

/// An array is one of texts then: the elements that fit are written as values of their type are. Objects among them are discarded,
/// with the bad values in them.
TBadValue TCimXmlItem::TakeBad()
{
    const std::vector<TBadText> bad = std::exchange(fBadTexts, {});
    TBadValue result{0, TCIMValue::FromText(bad.front().text), bad.front().text, bad.front().type, bad.front().place};
    if (!fType.IsArray()) {
        return result;
    }
    if (fMark != kNoMark) {
        fContext.GetBadValues().TakeBack(fMark);
    }
    for (TCIMValue& element : fElements) {
        element = element.IsNull() ? TCIMValue::Null(TType::kString) : TCIMValue::FromText(element.ToText());
    }
    for (const TBadText& one : bad) {
        fElements[one.position] = TCIMValue::FromText(one.text);
    }
    result.value = TCIMValue(TType::kArrayString, static_cast<unsigned int>(fElements.size()), fElements);
    fElements.clear();
    return result;
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

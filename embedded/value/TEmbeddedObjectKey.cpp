// The text of an embedded object that is a key.
//
//     <INSTANCE CLASSNAME="setting"><PROPERTY NAME="size" TYPE="sint32"><VALUE>1</VALUE></PROPERTY></INSTANCE>
//
// Equal objects must have equal texts, and different ones different texts. So names are in lower case and elements are sorted by
// name; what equality ignores is left out, and what it compares is there (TEmbeddedObject.cpp lists both). Attributes are left out
// only if they are empty or zero. Text is escaped in place, so it cannot be taken for an element. Bytes that XML does not allow
// stay as they are: this text is compared and shown, not parsed. Values are written as in keys; text, datetimes and references are
// without their double quotes, char16 keeps its single ones. Objects and arrays nest as elements.

#include <algorithm>

#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TObject = TEmbeddedObject;
using TAccess = TValueAccess;

/// The text of a value that is neither null nor an array or an object. The element around it takes the place of quotes.
std::string GetSimpleText(const TCIMValue& value)
{
    std::string text;
    switch (TAccess::GetForm(value)) {
    case TAccess::kDateTime:
        return value.GetDateTime().GetCanonical().ToText();
    case TAccess::kPath:
        return TAccess::GetPath(value).GetPath();
    case TAccess::kNumber:
        value.AppendKeyText(text);
        return text;
    default:
        return std::string(TAccess::GetText(value));
    }
}

/// Appends the parts of an object to a text.
class TObjectKeyWriter {
  public:
    explicit TObjectKeyWriter(std::string& out) noexcept : fOut(out) {}

    void Write(const TObject& object);

  private:
    void Write(const TObject::TQualifier& qualifier);
    void Write(const TObject::TProperty& property);
    void Write(const TObject::TParameter& parameter);
    void Write(const TObject::TMethod& method);
    void WriteValue(const TCIMValue& value);
    void WriteArray(const TCIMValue& value);
    void WriteEscaped(std::string_view text);
    void WriteName(const char* attribute, std::string_view name);
    void WriteNumber(const char* attribute, unsigned int number);
    void WriteType(TCIMValue::TCIMType type, const std::string& referenceClass, unsigned int arraySize);

    /// The elements in the order of their names.
    template <class T>
    void WriteSorted(const std::vector<T>& elements)
    {
        std::vector<const T*> sorted;
        sorted.reserve(elements.size());
        for (const T& element : elements) {
            sorted.push_back(&element);
        }
        std::stable_sort(sorted.begin(), sorted.end(),
                         [](const T* a, const T* b) { return TNameText::Compare(a->name, b->name) < 0; });
        for (const T* element : sorted) {
            Write(*element);
        }
    }

    std::string& fOut;
    bool fIsClass = false;  // whether the object at hand is a class
};

void TObjectKeyWriter::Write(const TObject& object)
{
    const bool isClassAround = fIsClass;
    fIsClass = object.IsClass();
    fOut += fIsClass ? "<CLASS" : "<INSTANCE";
    WriteName(fIsClass ? "NAME" : "CLASSNAME", object.GetClassName());
    if (!object.GetSuperClassName().empty()) {
        WriteName("SUPERCLASS", object.GetSuperClassName());
    }
    fOut += '>';
    WriteSorted(object.GetQualifiers());
    WriteSorted(object.GetProperties());
    WriteSorted(object.GetMethods());
    fOut += fIsClass ? "</CLASS>" : "</INSTANCE>";
    fIsClass = isClassAround;
}

void TObjectKeyWriter::Write(const TObject::TQualifier& qualifier)
{
    fOut += "<QUALIFIER";
    WriteName("NAME", qualifier.name);
    WriteName("TYPE", TValueText::DescribeType(qualifier.value.GetType()));
    WriteNumber("FLAVOR", static_cast<unsigned int>(qualifier.flavor));
    fOut += '>';
    WriteValue(qualifier.value);
    fOut += "</QUALIFIER>";
}

void TObjectKeyWriter::Write(const TObject::TProperty& property)
{
    if (!fIsClass && property.value.IsNull()) {
        return;
    }
    fOut += "<PROPERTY";
    WriteName("NAME", property.name);
    WriteType(property.value.GetType(), property.referenceClass, property.arraySize);
    fOut += '>';
    WriteSorted(property.qualifiers);
    WriteValue(property.value);
    fOut += "</PROPERTY>";
}

void TObjectKeyWriter::Write(const TObject::TParameter& parameter)
{
    fOut += "<PARAMETER";
    WriteName("NAME", parameter.name);
    WriteType(parameter.type, parameter.referenceClass, parameter.arraySize);
    fOut += '>';
    WriteSorted(parameter.qualifiers);
    fOut += "</PARAMETER>";
}

void TObjectKeyWriter::Write(const TObject::TMethod& method)
{
    fOut += "<METHOD";
    WriteName("NAME", method.name);
    WriteType(method.type, std::string(), 0);
    fOut += '>';
    WriteSorted(method.qualifiers);
    for (const TObject::TParameter& parameter : method.parameters) {
        Write(parameter);
    }
    fOut += "</METHOD>";
}

void TObjectKeyWriter::WriteValue(const TCIMValue& value)
{
    if (value.IsNull()) {
        fOut += "<VALUE.NULL/>";
    } else if (value.GetType().IsArray()) {
        WriteArray(value);
    } else if (TAccess::GetForm(value) == TAccess::kObject) {
        Write(*value.GetEmbeddedObject());
    } else {
        fOut += "<VALUE>";
        WriteEscaped(GetSimpleText(value));
        fOut += "</VALUE>";
    }
}

void TObjectKeyWriter::WriteArray(const TCIMValue& value)
{
    std::vector<std::string> texts;
    texts.reserve(value.GetElements().size());
    for (const TCIMValue& element : value.GetElements()) {
        TObjectKeyWriter(texts.emplace_back()).WriteValue(element);
    }
    if (value.IsBag()) {
        std::sort(texts.begin(), texts.end());
    }
    fOut += "<VALUE.ARRAY>";
    for (const std::string& text : texts) {
        fOut += text;
    }
    fOut += "</VALUE.ARRAY>";
}

void TObjectKeyWriter::WriteEscaped(std::string_view text)
{
    for (const char c : text) {
        switch (c) {
        case '&':
            fOut += "&amp;";
            break;
        case '<':
            fOut += "&lt;";
            break;
        case '"':
            fOut += "&quot;";
            break;
        default:
            fOut += c;
            break;
        }
    }
}

void TObjectKeyWriter::WriteName(const char* attribute, std::string_view name)
{
    fOut.append(1, ' ').append(attribute).append("=\"");
    WriteEscaped(TNameText::ToLower(name));
    fOut += '"';
}

void TObjectKeyWriter::WriteNumber(const char* attribute, unsigned int number)
{
    if (number != 0) {
        WriteName(attribute, std::to_string(number));
    }
}

void TObjectKeyWriter::WriteType(TCIMValue::TCIMType type, const std::string& referenceClass, unsigned int arraySize)
{
    WriteName("TYPE", TValueText::DescribeType(type));
    if (!referenceClass.empty()) {
        WriteName("REFERENCECLASS", referenceClass);
    }
    WriteNumber("ARRAYSIZE", arraySize);
}

}  // namespace

std::string TEmbeddedObject::GetKeyText() const
{
    std::string text;
    TObjectKeyWriter(text).Write(*this);
    return text;
}

}  // namespace NORVZEL20

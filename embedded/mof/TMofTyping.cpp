// From spelling to type.
//
// A literal shows its form (text, integer, real ...), not its type: 5 may be any integer, a real or a char16, and "..." a string, a
// datetime or a reference. The declared type decides. If the form is none of that type, Guess gives the value the type that the
// form suggests, and it is up to the one rule of conversions what becomes of it.
#include "embedded/mof/TMofTyping.h"

#include <algorithm>
#include <iterator>
#include <utility>
#include <vector>

#include "embedded/load/MessageText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TType = TCIMValue::TCIMType;

bool IsInteger(TType type)
{
    return type >= TType::kUint8 && type <= TType::kSint64;
}

bool IsReal(TType type)
{
    return type == TType::kReal32 || type == TType::kReal64;
}

bool ReadCharacterCode(const std::string& text, TCIMValue& result)
{
    TCIMValue code;
    if (!TValueText::Parse(TType::kUint16, text, code)) {
        return false;
    }
    result = TCIMValue(static_cast<char16_t>(code.GetUnsigned()));
    return true;
}

/// An empty text refers to nothing. A host says nothing without a namespace, so it is dropped, as in CIM-XML.
bool ReadReference(const std::string& text, TCIMValue& result)
{
    TCIMValue value;
    if (text.empty()) {
        result = TCIMValue::Null(TType::kReference);
        return true;
    }
    if (!TValueText::Convert(TCIMValue(text), TType::kReference, value)) {
        return false;
    }
    TCIMReference path = value;
    if (path.GetNamespaceName().empty() && !path.GetHost().empty()) {
        path.SetHost("");
        value = TCIMValue(path);
    }
    result = std::move(value);
    return true;
}

bool ReadText(const std::string& text, TType type, TCIMValue& result)
{
    if (type == TType::kString) {
        result = TCIMValue(text);
        return true;
    }
    return type == TType::kReference ? ReadReference(text, result)
                                     : type == TType::kDateTime && TValueText::Parse(type, text, result);
}

/// A value that is no array, in a type that is none.
bool ReadElement(const TMofValue& value, TType type, const TMofTyping::TResolve& resolve, TCIMValue& result)
{
    switch (value.kind) {
    case TMofValue::kNull:
        result = TCIMValue::Null(type);
        return true;
    case TMofValue::kBoolean:
        return type == TType::kBoolean && TValueText::Parse(type, value.text, result);
    case TMofValue::kInteger:
        return type == TType::kChar16 ? ReadCharacterCode(value.text, result)
                                      : (IsInteger(type) || IsReal(type)) && TValueText::Parse(type, value.text, result);
    case TMofValue::kReal:
        return IsReal(type) && TValueText::Parse(type, value.text, result);
    case TMofValue::kCharacter:
        return type == TType::kChar16 && TValueText::Parse(type, value.text, result);
    case TMofValue::kText:
        return ReadText(value.text, type, result);
    case TMofValue::kAlias:
    case TMofValue::kObject:
        if (!resolve || type != (value.kind == TMofValue::kAlias ? TType::kReference : TType::kString)) {
            return false;
        }
        result = resolve(value);
        return true;
    default:
        return false;
    }
}

}  // namespace

bool TMofTyping::Read(const TMofValue& value, TCIMValue::TCIMType type, const TResolve& resolve, TCIMValue& result)
{
    if (value.kind == TMofValue::kNull) {
        result = TCIMValue::Null(type);
        return true;
    }
    if (!type.IsArray() || value.kind != TMofValue::kArray) {
        return !type.IsArray() && ReadElement(value, type, resolve, result);
    }
    std::vector<TCIMValue> elements(value.elements.size());
    for (std::size_t index = 0; index < elements.size(); ++index) {
        if (!ReadElement(value.elements[index], type.GetElementType(), resolve, elements[index])) {
            return false;
        }
    }
    result = TCIMValue(type, static_cast<unsigned int>(elements.size()), elements);
    return true;
}

/// The order matters: each integer is also a real, and a datetime is a string here.
bool TMofTyping::Guess(const TMofValue& value, const TResolve& resolve, TCIMValue& result)
{
    static constexpr TType::ECIMType kTypes[] = {TType::kString, TType::kBoolean, TType::kUint64,   TType::kSint64,
                                                 TType::kReal64, TType::kChar16,  TType::kReference};
    if (value.kind == TMofValue::kNull) {
        result = TCIMValue();
        return true;
    }
    return std::any_of(std::begin(kTypes), std::end(kTypes), [&](TType type) {
        return Read(value, value.kind == TMofValue::kArray ? type.GetArrayType() : type, resolve, result);
    });
}

TCIMValue TMofTyping::ReadDeclared(TLoadContext& context, const std::string& what, const TMofValue& value, TCIMValue::TCIMType type)
{
    TCIMValue result;
    if (Read(value, type, TResolve(), result)) {
        return result;
    }
    TCIMValue guessed;
    if (!Guess(value, TResolve(), guessed) || !TValueText::Convert(guessed, type, result)) {
        context.Fail(TZELStatusCode::kTypeMismatch,
                     "found " + Describe(value) + " in " + what + ", which is declared as " + TValueText::DescribeType(type));
    }
    context.Tolerate("other type in MOF", what + " is written as " + TValueText::DescribeType(guessed.GetType()) +
                                              "; taken as the declared " + TValueText::DescribeType(type));
    return result;
}

std::string TMofTyping::Describe(const TMofValue& value)
{
    switch (value.kind) {
    case TMofValue::kNull:
        return "null";
    case TMofValue::kBoolean:
    case TMofValue::kInteger:
    case TMofValue::kReal:
        return value.text;
    case TMofValue::kAlias:
        return "the alias $" + value.text;
    case TMofValue::kObject:
        return "an instance";
    case TMofValue::kArray:
        return value.elements.empty() ? "an empty array" : "an array that begins with " + Describe(value.elements.front());
    default:
        return Quote(value.text);
    }
}

}  // namespace NORVZEL20

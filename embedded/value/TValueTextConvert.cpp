// Conversions for values whose type is not the declared one: keys of a path that was read from text, and properties that a document
// writes with another type.
//
// A number is converted only if the new type holds exactly the same number; nothing is rounded or cut off. Text is read as Parse
// reads it, and char16, datetimes and references become text. There is no other conversion.

#include <cmath>
#include <limits>

#include "embedded/value/TInteger.h"
#include "embedded/value/TTypeKind.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

using TType = TCIMValue::TCIMType;

/// A number becomes a real only if the real is exactly that number.
bool ConvertToReal(const TCIMValue& value, TType::ECIMType type, TCIMValue& result)
{
    double number = 0;
    if (TTypeKind::IsReal(value.GetType())) {
        number = value.GetReal();
    } else {
        const TInteger integer = TInteger::Read(value);
        number = static_cast<double>(integer.magnitude);
        // The bound is checked first, because 2^64 cannot be converted back.
        if (number >= 0x1p64 || static_cast<std::uint64_t>(number) != integer.magnitude) {
            return false;
        }
        number = integer.isNegative ? -number : number;
    }
    // A real32 must hold exactly this number. NaN and the infinities have no digits to lose.
    if (type == TType::kReal32 && !std::isnan(number) && !std::isinf(number) &&
        (std::fabs(number) > static_cast<double>(std::numeric_limits<float>::max()) ||
         static_cast<double>(static_cast<float>(number)) != number)) {
        return false;
    }
    result = TValueAccess::FromReal(type, number);
    return true;
}

/// A path that has keys or a namespace, but no class, refers to nothing and could not be written.
bool ConvertToPath(std::string_view text, TCIMValue& result)
{
    try {
        const TCIMReference path = TCIMReference::Parse(std::string(text));
        if (!text.empty() && !path.GetClass()) {
            return false;
        }
        result = TCIMValue(path);
        return true;
    } catch (const TZELException&) {
        return false;
    }
}

bool ConvertArray(const TCIMValue& value, TType type, TCIMValue& result)
{
    std::vector<TCIMValue> elements;
    elements.reserve(value.GetElements().size());
    for (const TCIMValue& element : value.GetElements()) {
        elements.emplace_back();
        if (!TValueText::Convert(element, type.GetElementType(), elements.back())) {
            return false;
        }
    }
    TCIMValue array(type, static_cast<unsigned int>(elements.size()), elements);
    result = value.IsBag() ? array.AsBag() : array;
    return true;
}

/// Integers go between all number types; a real stays a real.
bool ConvertNumber(const TCIMValue& value, TType::ECIMType type, TCIMValue& result)
{
    const bool isInteger = TTypeKind::IsInteger(value.GetType());
    if (isInteger && TTypeKind::IsInteger(type)) {
        return TInteger::Read(value).Make(type, result);
    }
    return (isInteger || TTypeKind::IsReal(value.GetType())) && TTypeKind::IsReal(type) && ConvertToReal(value, type, result);
}

}  // namespace

bool TValueText::Convert(const TCIMValue& value, TCIMValue::TCIMType type, TCIMValue& result)
{
    if (value.IsNull()) {
        // A null has a type too, so it gets the one asked for.
        result = TCIMValue::Null(type);
        return true;
    }
    const TType from = value.GetType();
    if (from == type) {
        result = value;
        return true;
    }
    if (from.IsArray() || type.IsArray()) {
        return from.IsArray() && type.IsArray() && ConvertArray(value, type, result);
    }
    if (TValueAccess::IsText(value)) {
        const std::string_view text = TValueAccess::GetText(value);
        return type == TType::kReference ? ConvertToPath(text, result) : Parse(type, text, result);
    }
    if (type == TType::kString) {
        const bool hasText = from == TType::kChar16 || from == TType::kDateTime || from == TType::kReference;
        return hasText && Parse(type, value.ToText(), result);
    }
    return ConvertNumber(value, type, result);
}

bool TValueText::ConvertKey(const TCIMValue& value, TCIMValue::TCIMType type, TCIMValue& result)
{
    if (Convert(value, type, result)) {
        return true;
    }
    if (value.GetType() != TType::kReal64 || type != TType::kReal32) {
        return false;
    }
    TCIMValue narrow;
    const std::string text = value.ToText();
    if (!Parse(type, text, narrow) || narrow.ToText() != text) {
        return false;
    }
    result = narrow;
    return true;
}

}  // namespace NORVZEL20

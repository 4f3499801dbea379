// Parses a text as a value of every type, and as a datetime.
//
// The text of a parsed value must parse to an equal value and then be the same text. Converting a number to another type and back
// must not change it. The text of a path that has the value as its key must parse to the same path.

#include "embedded/value/TValueText.h"
#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"
#include "host/TCIMDateTime.h"
#include "host/TCIMReference.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

using TType = TCIMValue::TCIMType;

bool IsNumber(TType type)
{
    return type >= TType::kUint8 && type <= TType::kReal64;
}

/// The text of a parsed value parses to the same value.
void CheckText(TType type, const TCIMValue& value)
{
    Promise(value.GetType() == type && !value.IsNull(), "a parsed value has the type asked for");
    Promise(value == value && value.Hash() == TCIMValue(value).Hash(), "a value equals itself");
    std::string text;
    TValueText::AppendPlain(text, value);
    TCIMValue again;
    Promise(TValueText::Parse(type, text, again), "a value's text can be parsed", text);
    Promise(again == value && again.Hash() == value.Hash(), "a value's text parses to the value", text);
    std::string second;
    TValueText::AppendPlain(second, again);
    PromiseEqual(text, second, "a value's text is a fixed point");
    Promise(!value.ToText().empty() || type == TType::kString, "a value has a text for people");
}

/// A number that is converted to another type and back is the same number.
void CheckConversions(const TCIMValue& value)
{
    for (unsigned char code = TType::kBoolean; code <= TType::kReference; ++code) {
        const TType type(static_cast<TType::ECIMType>(code));
        TCIMValue converted;
        if (!TValueText::Convert(value, type, converted)) {
            continue;
        }
        Promise(converted.GetType() == type, "a converted value has the type asked for");
        TCIMValue back;
        if (IsNumber(value.GetType()) && IsNumber(type) && TValueText::Convert(converted, value.GetType(), back)) {
            Promise(back == value, "a conversion loses nothing", value.ToText() + " became " + back.ToText());
        }
    }
}

/// The text of a path with the value as its only key parses to the same path.
void CheckKeyText(const TCIMValue& value)
{
    TCIMReference path;
    path.SetClassName("C");
    path.AddKeyValue("K", value);
    const TCIMReference again = TCIMReference::Parse(path.GetPath());
    Promise(again.GetKeyCount() == 1, "one key stays one key", path.GetPath());
    PromiseEqual(path.GetPath(), again.GetPath(), "a key's text is a fixed point");
}

void CheckDateTime(std::string_view text)
{
    TCIMDateTime value;
    if (!TCIMDateTime::Parse(text, value)) {
        return;
    }
    // The offset zero can be written in two ways.
    const std::string kept(text);
    const bool isMinusZero = kept.substr(kept.size() - 4) == "-000";
    PromiseEqual(isMinusZero ? kept.substr(0, kept.size() - 4) + "+000" : kept, value.ToText(), "a datetime keeps its text");
    Promise(value == value && !(value < value), "a datetime equals itself");
    TCIMDateTime canonical;
    Promise(TCIMDateTime::Parse(value.GetCanonical().ToText(), canonical) && canonical == value,
            "the canonical form is a datetime and equal", kept);
    const TCIMDateTime epoch;
    Promise((value < epoch) + (epoch < value) + (value == epoch) <= 1, "datetimes have an order");
}

}  // namespace

void FuzzValue(std::string_view input)
{
    for (unsigned char code = TType::kBoolean; code <= TType::kDateTime; ++code) {
        const TType type(static_cast<TType::ECIMType>(code));
        TCIMValue value;
        if (!TValueText::Parse(type, input, value)) {
            Promise(value == TCIMValue() && value.GetType() == TType::kNone, "a text that is refused changes nothing");
            continue;
        }
        CheckText(type, value);
        CheckConversions(value);
        CheckKeyText(value);
    }
    CheckDateTime(input);
}

}  // namespace NORVZEL20

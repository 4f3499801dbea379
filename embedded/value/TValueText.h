#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "host/Export.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The text forms of values. They do not depend on a locale.
class CIMDELTA_INTERNAL_EXPORT TValueText {
  public:
    TValueText() = delete;

    /// Reads `text` as a value of the non-array type `type`, as CIM-XML writes them (DSP0201, 5.2.4 "VALUE").
    ///
    /// - boolean: TRUE or FALSE in any letter case
    /// - integer: decimal, or hexadecimal after 0x, within the type's range; a sign is optional, "-" only for signed types
    /// - real: decimal with an optional exponent, within the type's range and rounded to the type; INF, -INF, NaN in any case
    /// - char16: one UCS-2 unit in UTF-8
    /// - datetime: 25 characters
    /// - string: the text as it is
    ///
    /// White space around the text is ignored, except for strings and char16. Returns false, and leaves `result` as it is, for
    /// every other text and for references and arrays.
    static bool Parse(TCIMValue::TCIMType type, std::string_view text, TCIMValue& result);

    /// Converts `value` to the type `type` if nothing is lost:
    ///
    /// - a null, and a value that has the type already
    /// - an integer to an integer type whose range includes it, a number to a real type that holds it exactly
    /// - text to a reference, if it names a class or is empty, or to any type that Parse can read from it
    /// - char16, datetime and reference to text
    /// - an array to an array, element by element; a bag stays a bag
    ///
    /// Returns false, and leaves `result` as it is, for everything else.
    static bool Convert(const TCIMValue& value, TCIMValue::TCIMType type, TCIMValue& result);

    /// Converts a key that was read from a path to the key's declared type: as Convert, or to a real32 that has the same text. 0.1
    /// is read as a real64, and no real32 is exactly that number. Returns false, and leaves `result` as it is, for everything else.
    static bool ConvertKey(const TCIMValue& value, TCIMValue::TCIMType type, TCIMValue& result);

    /// The name of a type in CIM-XML: "uint16" for the type and for arrays of it, "reference", "" for kNone.
    static const char* GetTypeName(TCIMValue::TCIMType type) noexcept;
    /// A type for people: "uint16", "uint16[]", "none".
    static std::string DescribeType(TCIMValue::TCIMType type);
    /// The element type of that name in lower case ("reference" included); kNone if no type has that name.
    static TCIMValue::TCIMType FindType(std::string_view name) noexcept;

    /// Appends a boolean, number, char16, text or datetime, unquoted and unescaped. The value must not be null.
    static void AppendPlain(std::string& out, const TCIMValue& value);
    /// Whether `text` has a `quote` or a `\`.
    static bool NeedsEscape(std::string_view text, char quote) noexcept;
    /// Appends `text` between two `quote` characters, with a `\` in front of each `quote` and `\`.
    static void AppendQuoted(std::string& out, std::string_view text, char quote);
    /// The same for the text that `write(out)` appends.
    template <class TWriter>
    static void AppendQuotedBy(std::string& out, char quote, const TWriter& write)
    {
        out += quote;
        const std::size_t start = out.size();
        write(out);
        EscapeFrom(out, start, quote);
        out += quote;
    }
    static void AppendUnsigned(std::string& out, std::uint64_t number);
    static void AppendSigned(std::string& out, std::int64_t number);
    /// The shortest text that reads back as the same double, or as the same float for real32; INF, -INF, NaN.
    static void AppendReal(std::string& out, double number, bool isReal32);

  private:
    static void EscapeFrom(std::string& out, std::size_t start, char quote);
};

}  // namespace NORVZEL20

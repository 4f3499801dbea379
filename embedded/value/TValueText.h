#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The text forms of values, without any locale.
class TValueText {
  public:
    TValueText() = delete;

    /// Reads `text` as a value of the non-array type `type`, as CIM-XML writes them (DSP0201, 5.2.4 "VALUE").
    ///
    /// Booleans TRUE and FALSE in any letter case; integers in decimal or 0x hexadecimal, with an optional sign ("-" for signed
    /// types alone), within the type's range; reals in decimal with optional exponent, INF, -INF, NaN in any letter case, rounded
    /// to the type and within its range; char16 exactly one UCS-2 unit in UTF-8; datetimes of 25 characters; strings as they are.
    /// White space around is left out for all but strings and char16. Returns false, and leaves `result` as it is, for everything
    /// else, references and arrays included.
    static bool Parse(TCIMValue::TCIMType type, std::string_view text, TCIMValue& result);

    /// Gives `value` the type `type` where that loses nothing: itself where it has the type already, nulls, integers to integers
    /// within range, integers and reals to reals that hold them exactly, text to whatever Parse reads from it and to references,
    /// char16, datetimes and references to text, arrays element by element. Returns false, and leaves `result` as it is, otherwise.
    static bool Convert(const TCIMValue& value, TCIMValue::TCIMType type, TCIMValue& result);

    /// The name of a type in CIM-XML: "uint16" for the type and for arrays of it, "reference", "" for kNone.
    static const char* GetTypeName(TCIMValue::TCIMType type) noexcept;
    /// A type for people: "uint16", "uint16[]", "none".
    static std::string DescribeType(TCIMValue::TCIMType type);
    /// The element type of that name in lower case ("reference" included); kNone if no type has that name.
    static TCIMValue::TCIMType FindType(std::string_view name) noexcept;

    /// Appends a non-null boolean, number, char16, text or datetime as it is, unquoted and unescaped.
    static void AppendPlain(std::string& out, const TCIMValue& value);
    /// Appends `text` between two `quote` characters, with `quote` and `\` escaped by `\`.
    static void AppendQuoted(std::string& out, std::string_view text, char quote);
    /// The same for text that `write(out)` appends itself.
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
    /// The shortest text that reads back as the same double (for real32: as the same float); INF, -INF, NaN.
    static void AppendReal(std::string& out, double number, bool isReal32);

  private:
    static void EscapeFrom(std::string& out, std::size_t start, char quote);
};

}  // namespace NORVZEL20

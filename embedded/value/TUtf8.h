#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace NORVZEL20 {

/// UTF-8, one character at a time.
///
/// A character is a lead byte and the continuation bytes (10xxxxxx) that the lead byte announces:
///
///     00..7F    0xxxxxxx  alone
///     C2..DF    110xxxxx  and 1 continuation byte
///     E0..EF    1110xxxx  and 2
///     F0..F4    11110xxx  and 3
///
/// Every other byte, and a lead byte with fewer continuation bytes behind it, begins no character. The shape alone still admits
/// what the standard forbids: a longer form than needed, a surrogate, a number above U+10FFFF. Inventories contain such bytes, and
/// what to do about them depends on the reader, so the decoder accepts them and the character answers the questions.
class TUtf8 {
  public:
    TUtf8() = delete;

    struct TCharacter {
        char32_t code;       ///< the lead byte itself if no character begins there
        std::size_t length;  ///< in bytes, 1 to 4; 0 if no character begins there

        /// Whether a shorter sequence would give the same code.
        bool IsOverlong() const noexcept { return length > GetLength(code); }
        /// Whether the code is one that Unicode can assign: up to U+10FFFF and no surrogate.
        bool IsScalar() const noexcept { return code <= 0x10FFFF && (code < 0xD800 || code > 0xDFFF); }
        /// Whether it is a character that the standard allows.
        bool IsValid() const noexcept { return length > 0 && !IsOverlong() && IsScalar(); }
    };

    static bool IsContinuation(char c) noexcept { return (static_cast<unsigned char>(c) & 0xC0U) == 0x80U; }

    /// The character at the beginning of `text`, which must not be empty.
    static TCharacter Decode(std::string_view text) noexcept
    {
        const auto lead = static_cast<unsigned char>(text[0]);
        const std::size_t length = GetAnnouncedLength(lead);
        if (length == 1) {
            return {lead, 1};
        }
        if (length == 0 || length > text.size()) {
            return {lead, 0};
        }
        char32_t code = lead & (0x7FU >> length);
        for (std::size_t i = 1; i < length; ++i) {
            if (!IsContinuation(text[i])) {
                return {lead, 0};
            }
            code = code << 6 | (static_cast<unsigned char>(text[i]) & 0x3FU);
        }
        return {code, length};
    }

    /// Where the first byte stands that begins no valid character; the length of `text` if each character is valid.
    static std::size_t FindInvalid(std::string_view text) noexcept
    {
        std::size_t place = 0;
        while (place < text.size()) {
            const TCharacter character = Decode(text.substr(place));
            if (!character.IsValid()) {
                return place;
            }
            place += character.length;
        }
        return place;
    }

    /// Appends the shortest form of `code`, which must be below 0x200000. Surrogates are encoded like any other code.
    static void Append(std::string& out, char32_t code)
    {
        const std::size_t length = GetLength(code);
        if (length == 1) {
            out += static_cast<char>(code);
            return;
        }
        out += static_cast<char>((0xF00U >> length & 0xFFU) | code >> (6 * (length - 1)));
        for (std::size_t i = length - 1; i-- > 0;) {
            out += static_cast<char>(0x80U | (code >> (6 * i) & 0x3FU));
        }
    }

    /// The first `limit` bytes of a longer text, without the last character if that has several bytes, because the cut may have
    /// split it. A text of up to `limit` bytes comes back whole.
    static std::string_view Shorten(std::string_view text, std::size_t limit) noexcept
    {
        if (text.size() <= limit) {
            return text;
        }
        std::string_view start = text.substr(0, limit);
        while (!start.empty() && IsContinuation(start.back())) {
            start.remove_suffix(1);
        }
        if (!start.empty() && static_cast<unsigned char>(start.back()) >= 0xC0U) {
            start.remove_suffix(1);
        }
        return start;
    }

  private:
    static std::size_t GetAnnouncedLength(unsigned char lead) noexcept
    {
        if (lead < 0x80U) {
            return 1;
        }
        if (lead < 0xC2U || lead > 0xF4U) {
            return 0;
        }
        return lead < 0xE0U ? 2 : (lead < 0xF0U ? 3 : 4);
    }

    static std::size_t GetLength(char32_t code) noexcept { return code < 0x80 ? 1 : (code < 0x800 ? 2 : (code < 0x10000 ? 3 : 4)); }
};

}  // namespace NORVZEL20

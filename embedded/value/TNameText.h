#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <map>
#include <string>
#include <string_view>
#include <unordered_map>

#include "host/Export.h"

namespace NORVZEL20 {

/// Names of classes, properties, qualifiers and namespaces. The letter case of ASCII letters does not matter. No locale is
/// involved.
class CIMDELTA_EXPORT TNameText {
  public:
    TNameText() = delete;

    static constexpr char ToLower(char c) noexcept { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c; }
    static std::string ToLower(std::string_view name);
    /// Whether a name may begin with `c`: a letter, an underscore or any byte of a character beyond ASCII.
    static constexpr bool IsNameStart(char c) noexcept
    {
        return (ToLower(c) >= 'a' && ToLower(c) <= 'z') || c == '_' || static_cast<unsigned char>(c) >= 0x80;
    }
    /// Whether a name may go on with `c`: a digit or what IsNameStart accepts.
    static constexpr bool IsNamePart(char c) noexcept { return IsNameStart(c) || (c >= '0' && c <= '9'); }
    static bool Equal(std::string_view a, std::string_view b) noexcept;
    /// Whether both are the same bytes.
    static bool HasSameSpelling(std::string_view a, std::string_view b) noexcept
    {
        using TWord = std::uint64_t;
        using THalf = std::uint32_t;
        if (a.size() != b.size()) {
            return false;
        }
        if (a.size() < sizeof(THalf)) {
            return a == b;
        }
        if (a.size() < sizeof(TWord)) {
            return HasSameEnds<THalf>(a, b);
        }
        for (std::size_t at = sizeof(TWord); at + sizeof(TWord) < a.size(); at += sizeof(TWord)) {
            if (Load<TWord>(a, at) != Load<TWord>(b, at)) {
                return false;
            }
        }
        return HasSameEnds<TWord>(a, b);
    }
    /// Negative, zero or positive, as the bytes of the lower-case forms compare.
    static int Compare(std::string_view a, std::string_view b) noexcept;
    /// The same for names that are Equal. All 32 bits are usable.
    static std::uint32_t Hash(std::string_view name) noexcept;

    /// Functors for containers. TLess also allows look-up by std::string_view.
    struct TLess {
        using is_transparent = void;
        bool operator()(std::string_view a, std::string_view b) const noexcept { return Compare(a, b) < 0; }
    };
    struct TEqual {
        bool operator()(std::string_view a, std::string_view b) const noexcept { return Equal(a, b); }
    };
    struct THash {
        std::size_t operator()(std::string_view name) const noexcept { return Hash(name); }
    };

  private:
    template <class TWord>
    static TWord Load(std::string_view text, std::size_t position) noexcept
    {
        TWord word;
        std::memcpy(&word, text.data() + position, sizeof word);
        return word;
    }

    /// Whether the first and the last word of two texts of one length are the same. In a text shorter than two words they overlap.
    template <class TWord>
    static bool HasSameEnds(std::string_view a, std::string_view b) noexcept
    {
        const std::size_t last = a.size() - sizeof(TWord);
        return ((Load<TWord>(a, 0) ^ Load<TWord>(b, 0)) | (Load<TWord>(a, last) ^ Load<TWord>(b, last))) == 0;
    }
};

/// Keyed by name and ordered by it; `find` takes any text and makes no std::string.
template <class T>
using TNameMap = std::map<std::string, T, TNameText::TLess>;

/// Keyed by a name that the map does not own, such as that of the entry's value. The name must outlive the entry.
template <class T>
using TNameHashMap = std::unordered_map<std::string_view, T, TNameText::THash, TNameText::TEqual>;

}  // namespace NORVZEL20

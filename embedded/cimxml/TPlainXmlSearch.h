#pragma once

#include <cstddef>
#include <cstring>

namespace NORVZEL20 {

/// The searches of the tokenizer, for any processor: see TXmlSearch.
struct TPlainXmlSearch {
    TPlainXmlSearch() = delete;

    static constexpr std::size_t kReadsBeyond = 1;

    static const char* FindSpecial(const char* from, char delimiter) noexcept
    {
        for (;; ++from) {
            const char c = *from;
            if (c == '<' || c == '&' || c == delimiter || static_cast<unsigned char>(c) < ' ' ||
                static_cast<unsigned char>(c) >= 0x80U) {
                return from;
            }
        }
    }

    static bool AreSame(const char* one, const char* other, std::size_t length) noexcept
    {
        return std::memcmp(one, other, length) == 0;
    }

    static std::size_t CountLineEnds(const char* from, const char* to) noexcept
    {
        std::size_t count = 0;
        for (; from < to; ++from) {
            count += *from == '\n' || (*from == '\r' && from[1] != '\n') ? 1 : 0;
        }
        return count;
    }
};

}  // namespace NORVZEL20

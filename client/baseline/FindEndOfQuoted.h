#pragma once

#include <cstddef>
#include <string_view>

namespace NORVZEL20 {

/// Where the text in quotes ends whose first quote is at `begin`: the position of the other quote, or npos if there is none. A
/// backslash takes the next character as it is.
inline std::size_t FindEndOfQuoted(std::string_view text, std::size_t begin)
{
    for (std::size_t i = begin + 1; i < text.size(); ++i) {
        if (text[i] == text[begin]) {
            return i;
        }
        i += text[i] == '\\' ? 1 : 0;
    }
    return std::string_view::npos;
}

}  // namespace NORVZEL20

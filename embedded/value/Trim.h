#pragma once

#include <string_view>

namespace NORVZEL20 {

/// The part of `text` between the first and the last character that is not one of `characters`.
inline std::string_view Trim(std::string_view text, std::string_view characters) noexcept
{
    const std::size_t first = text.find_first_not_of(characters);
    return first == std::string_view::npos ? std::string_view() : text.substr(first, text.find_last_not_of(characters) + 1 - first);
}

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string_view>

namespace NORVZEL20 {

/// Calls back with the position of each character that is not within quotes, nor a quote, as long as it returns true. Double and
/// single quotes count; within them a backslash takes the next character as it is. Returns the position of the
/// quote that is not closed, or npos.
template <class TCallback>
std::size_t ForEachUnquoted(std::string_view text, const TCallback& callback)
{
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '"' && text[i] != '\'') {
            if (!callback(i)) {
                break;
            }
            continue;
        }
        const std::size_t opened = i;
        for (++i; i < text.size() && text[i] != text[opened]; ++i) {
            i += text[i] == '\\' ? 1 : 0;
        }
        if (i >= text.size()) {
            return opened;
        }
    }
    return std::string_view::npos;
}

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string_view>

#include "client/baseline/FindEndOfQuoted.h"

namespace NORVZEL20 {

/// Calls back with the position of each character that is not within quotes, nor a quote, as long as it returns true. Double and
/// single quotes count; FindEndOfQuoted says where they end. Returns the position of the quote that is not closed, or npos.
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
        const std::size_t end = FindEndOfQuoted(text, i);
        if (end == std::string_view::npos) {
            return i;
        }
        i = end;
    }
    return std::string_view::npos;
}

}  // namespace NORVZEL20

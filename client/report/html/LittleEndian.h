#pragma once

#include <cstddef>
#include <cstdint>
#include <stdexcept>
#include <string_view>

#include "client/files/TSpooledText.h"

namespace NORVZEL20 {

/// Appends a number as four bytes, the lowest first. Errors: std::length_error for one that is too large; std::bad_alloc.
inline void AppendNumber(TSpooledText& numbers, std::size_t number)
{
    if (number > UINT32_MAX) {
        throw std::length_error("a page counts only up to 4294967295");
    }
    char bytes[4];
    for (unsigned i = 0; i < sizeof bytes; ++i) {
        bytes[i] = static_cast<char>(number >> 8U * i & 0xFFU);
    }
    numbers.Append(std::string_view(bytes, sizeof bytes));
}

}  // namespace NORVZEL20

#pragma once

namespace NORVZEL20 {

/// Whether XML 1.0 allows the character with this code in a document.
inline bool IsXmlCharacter(char32_t code) noexcept
{
    if (code < U' ') {
        return code == U'\t' || code == U'\n' || code == U'\r';
    }
    return (code < 0xD800 || code > 0xDFFF) && code != 0xFFFE && code != 0xFFFF && code <= 0x10FFFF;
}

}  // namespace NORVZEL20

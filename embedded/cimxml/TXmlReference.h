#pragma once

#include <cstddef>

#include "embedded/cimxml/EXmlScan.h"

namespace NORVZEL20 {

/// A reference to a character: by number, or by one of the five names that XML defines.
struct TXmlReference {
    EXmlScan scan;       ///< the other fields count only if it is accepted
    char32_t code;       ///< the character
    std::size_t length;  ///< bytes from the ampersand to the semicolon, both included

    /// The reference whose ampersand is at `from`; the bytes end at `end`. References to other entities are refused.
    static TXmlReference Read(const char* from, const char* end) noexcept;
};

}  // namespace NORVZEL20

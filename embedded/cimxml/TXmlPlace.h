#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// A place in a document, counted from 1. Columns count characters.
struct TXmlPlace {
    std::size_t line = 1;
    std::size_t column = 1;

    /// Moves over the bytes from `from` to `to`, which must be valid UTF-8. A line ends with a line feed, a carriage return, or
    /// both; `to` must not be between the two. The byte at `to` is read. Cost: linear.
    void Advance(const char* from, const char* to) noexcept;
};

}  // namespace NORVZEL20

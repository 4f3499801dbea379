#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// A place in a document, counted from 1. Columns count characters.
struct TTextPlace {
    std::size_t line = 1;
    std::size_t column = 1;
};

}  // namespace NORVZEL20

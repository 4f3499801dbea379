#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// "1 class", "2 classes": the number and the noun in its form.
inline std::string Counted(std::size_t count, const std::string& one, const std::string& many)
{
    return std::to_string(count) + " " + (count == 1 ? one : many);
}

/// The same for nouns that take an s.
inline std::string Counted(std::size_t count, const std::string& noun)
{
    return Counted(count, noun, noun + "s");
}

}  // namespace NORVZEL20

#include "client/text/NumberIn.h"

#include <charconv>

namespace NORVZEL20 {

std::optional<std::uint64_t> NumberIn(std::string_view text, int base)
{
    std::uint64_t number = 0;
    const char* const end = text.data() + text.size();
    const std::from_chars_result read = std::from_chars(text.data(), end, number, base);
    if (read.ec != std::errc() || read.ptr != end) {
        return std::nullopt;
    }
    return number;
}

}  // namespace NORVZEL20

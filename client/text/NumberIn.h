#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace NORVZEL20 {

/// The text as a whole as a number without a sign; nothing if it is no such number or too great.
std::optional<std::uint64_t> NumberIn(std::string_view text, int base = 10);

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// The bytes as text that XML can carry: each byte that begins no valid character, and each byte of a character that XML does not
/// have, becomes a backslash, an x and two hexadecimal digits. Line ends and tabs stay.
std::string ValidText(std::string_view bytes);

}  // namespace NORVZEL20

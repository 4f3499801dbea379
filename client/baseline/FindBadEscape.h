#pragma once

#include <cstddef>
#include <string_view>

namespace NORVZEL20 {

/// Where a backslash within quotes stands that begins none of the escapes that a baseline writes: one of the quote around it, of a
/// backslash, or of EscapeForDisplay. npos if all do. Quotes must be closed.
std::size_t FindBadEscape(std::string_view text);

}  // namespace NORVZEL20

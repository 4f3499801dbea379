#pragma once

#include <string>
#include <string_view>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Text from an inventory as a terminal can safely show it: control characters, characters that turn the direction of writing and
/// bytes that are no UTF-8 become escapes (\n, \t, \x1b, \u202e); everything else stays.
std::string EscapeForDisplay(std::string_view text);

/// A value for people, in one line. Text stands bare where that is clear; it is put in double quotes where it is empty, begins or
/// ends with a blank, holds a control character, quote, backslash or one of the signs that a report uses itself, or could be
/// taken for NULL.
std::string DisplayValue(const TCIMValue& value);

}  // namespace NORVZEL20

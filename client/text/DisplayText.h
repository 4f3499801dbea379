#pragma once

#include <string>
#include <string_view>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Text from an inventory as a terminal can safely show it, in one line: control characters, characters that change the direction
/// of writing or end a line, and bytes that are not UTF-8 become escapes (\n, \t, \x1b, \u202e). Everything else stays.
std::string EscapeForDisplay(std::string_view text);

/// A value for people, in one line; NULL for null. Text is put in double quotes if it is empty, begins or ends with a blank, reads
/// NULL, or holds a quote, a backslash, a character that EscapeForDisplay replaces, or " -> " or " / ", which reports use between
/// values. Within the quotes a backslash stands before each quote and backslash. Other text is shown as it is.
std::string DisplayValue(const TCIMValue& value);

}  // namespace NORVZEL20

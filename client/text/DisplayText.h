#pragma once

#include <string>
#include <string_view>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Text from an inventory as a terminal can safely show it, in one line: control characters, characters that change the direction
/// of writing, end a line, are invisible or look like a blank, and bytes that are not UTF-8 become escapes (\n, \t, \x1b, \u202e,
/// \u00a0). Everything else stays.
std::string EscapeForDisplay(std::string_view text);

/// The label of an inventory (see MakeInventoryLabels) as a part of a sentence or a list. A label is put in double quotes if it
/// holds a blank or a quote or ends in a punctuation mark, because the text around it could then be taken for a part of it, and if
/// it reads as several inventories do: `all`, `others`, `web01..04`. Within the quotes a backslash stands before each quote.
/// Different labels stay different.
std::string DisplayLabel(std::string_view label);

/// Text in double quotes, with a backslash before each quote and backslash of its own, and escaped as by EscapeForDisplay.
std::string QuoteForDisplay(std::string_view text);

// What reports put between and behind values.
inline constexpr char kBeforeNewValue[] = " -> ";
inline constexpr char kBetweenValues[] = " / ";
inline constexpr char kWithThisKey[] = " with this key";

/// A value for people, in one line; NULL for null. Text, also of a single character, is put in double quotes if it is empty, begins
/// or ends with a blank, reads NULL, or holds a quote, a backslash, a character that EscapeForDisplay replaces, or one of the texts
/// above. Within the quotes a backslash stands before each quote and backslash. Other text is shown as it is.
std::string DisplayValue(const TCIMValue& value);

}  // namespace NORVZEL20

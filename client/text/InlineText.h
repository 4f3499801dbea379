#pragma once

#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A value within a line that says more: as by DisplayContents, but text is also put in quotes if it holds a mark that such lines
/// use (a comma, a semicolon, an equals sign, braces, brackets, a colon in front of a blank, "...", " and ") or begins with a sign.
std::string InlineText(const TCIMValue& value);

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A value as part of a list: as by DisplayContents, but text is also put in quotes if it holds a comma or a brace, and the texts
/// in an array only if they need quotes: `{mallory, "a, b"}`.
std::string ListedText(const TCIMValue& value);

}  // namespace NORVZEL20

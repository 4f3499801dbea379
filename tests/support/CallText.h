#pragma once

#include <string>

#include "host/TCIMReference.h"
#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// The parts of a call's line.

/// " {}" for an empty context, else " {name=value, ...}".
std::string ContextText(const TCallContext& context);
/// The text in double quotes, nothing escaped.
std::string Quoted(const std::string& text);
/// A value with its text in quotes, so that NULL and "NULL" differ.
std::string ValueText(const TCIMValue& value);
std::string FlagText(bool flag);

}  // namespace NORVZEL20

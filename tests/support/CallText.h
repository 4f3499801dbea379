#pragma once

#include <string>

#include "host/TCIMReference.h"
#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// Texts for the lines of recorded calls.

/// Returns " {}" for an empty context, otherwise " {name=value, ...}".
std::string ContextText(const TCallContext& context);
/// The text in double quotes, without escapes.
std::string Quoted(const std::string& text);
/// The text of a value; texts are quoted, so NULL and "NULL" differ.
std::string ValueText(const TCIMValue& value);
std::string FlagText(bool flag);

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "host/ICIMPropertyDecl.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The value of a qualifier of a declaration; null if it has no such qualifier.
TCIMValue ValueOfQualifier(const ICIMPropertyDecl& declaration, const char* name);

/// The same as a text; empty if the value is no string.
std::string TextOfQualifier(const ICIMPropertyDecl& declaration, const char* name);

}  // namespace NORVZEL20

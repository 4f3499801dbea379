#pragma once

#include <string>

#include "embedded/mof/TMofTokens.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Reads the types of properties, methods, parameters and qualifiers. Errors: kParseError (9).
class TMofTypeParser {
  public:
    TMofTypeParser() = delete;

    /// The name of a type that is no reference.
    static TCIMValue::TCIMType ReadType(TMofTokens& tokens);
    /// The name of a type, or of a class with "ref" behind it, which becomes `referenceClass`. The result of a method may be
    /// "void", which is kNone.
    static TCIMValue::TCIMType ReadTypeOrReference(TMofTokens& tokens, std::string& referenceClass);
    /// The array type if square brackets follow, with the number between them as `size`; otherwise `type`, and 0 as `size`.
    static TCIMValue::TCIMType ReadArraySize(TMofTokens& tokens, TCIMValue::TCIMType type, unsigned int& size);
};

}  // namespace NORVZEL20

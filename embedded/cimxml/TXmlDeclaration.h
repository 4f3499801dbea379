#pragma once

#include "embedded/cimxml/EXmlScan.h"

namespace NORVZEL20 {

/// The declaration at the beginning of a document: <?xml version="1.0" encoding="utf-8" standalone="yes"?>
class TXmlDeclaration {
  public:
    TXmlDeclaration() = delete;

    /// Moves `at`, the beginning of a document, over the declaration, if there is one. Refuses versions and encodings other than
    /// these, and a document that is only a blank so far. The bytes end at `end`, and a NUL is there.
    static EXmlScan Pass(const char*& at, const char* end) noexcept;

    /// Accepts what begins at `at` as the beginning of another document, behind the end of one: a start tag whose name begins with
    /// a letter of ASCII, a declaration or a byte order mark. The bytes end at `end`.
    static EXmlScan FindNext(const char* at, const char* end) noexcept;
};

}  // namespace NORVZEL20

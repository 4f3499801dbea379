#pragma once

#include <cstddef>
#include <string>

#include "embedded/load/TTextPlace.h"

namespace NORVZEL20 {

/// A piece of a MOF document.
struct TMofToken {
    enum EKind : unsigned char {
        kEnd,        ///< behind the last token; its text is empty
        kName,       ///< a keyword or a name, as it is written
        kAlias,      ///< the name of an alias, without its dollar sign
        kText,       ///< one text literal, without its quotes and escapes
        kCharacter,  ///< a character literal: one character in UTF-8
        kInteger,    ///< in decimal, with "-" in front if it is negative
        kReal,       ///< as it is written
        kSymbol      ///< one punctuation mark
    };

    EKind kind = kEnd;
    std::string text;
    TTextPlace place;        ///< of its first character
    std::size_t offset = 0;  ///< of its first byte
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// A piece of a query's text.
struct TQueryToken {
    enum EKind {
        kEnd,     ///< behind the last piece; its text is empty
        kName,    ///< a key word or a name, as written
        kText,    ///< a literal, without its quotes and escapes
        kNumber,  ///< as written
        kSymbol   ///< an operator or a punctuation mark
    };

    EKind kind = kEnd;
    std::string text;
    std::size_t position = 0;  ///< of its first byte
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// A piece of a query's text.
struct TQueryToken {
    enum EKind {
        kEnd,     ///< behind the last token; its text is empty
        kName,    ///< a key word or a name, in the spelling of the query
        kText,    ///< a text literal, without its quotes and escapes
        kNumber,  ///< a number, in the spelling of the query
        kSymbol   ///< an operator or a punctuation mark
    };

    EKind kind = kEnd;
    std::string text;
    std::size_t position = 0;  ///< byte offset of its beginning
};

}  // namespace NORVZEL20

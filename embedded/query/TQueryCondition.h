#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "embedded/query/TLikePattern.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// One side of a test: a property or a literal.
struct TQueryOperand {
    std::string name;      ///< the property; empty for a literal
    TCIMValue literal;     ///< string, uint64, sint64, real64, boolean or null
    std::size_t position;  ///< byte offset in the query's text
    std::size_t ordinal;   ///< the number of properties in front of this one in the condition
    bool isClass = false;  ///< whether this is the name of the query's class, in front of ISA
};

/// A condition of a query, as a tree. It is not bound to a class yet (see TQueryMatcher).
struct TQueryCondition {
    enum EKind {
        kOr,     ///< of all parts
        kAnd,    ///< of all parts
        kNot,    ///< of parts[0]
        kEqual,  ///< this and the next five compare operands[0] with operands[1]
        kNotEqual,
        kLess,
        kLessOrEqual,
        kGreater,
        kGreaterOrEqual,
        kLike,    ///< operands[0] and pattern
        kIsNull,  ///< operands[0]
        kIsA      ///< operands[0] and className
    };

    TQueryCondition(EKind ofKind, std::size_t at) noexcept : kind(ofKind), position(at) {}

    EKind kind;
    std::size_t position;
    std::vector<std::unique_ptr<TQueryCondition>> parts;
    std::vector<TQueryOperand> operands;
    std::unique_ptr<TLikePattern> pattern;
    std::string className;
};

}  // namespace NORVZEL20

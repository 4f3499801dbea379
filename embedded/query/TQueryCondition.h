#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "embedded/query/TLikePattern.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// One side of a test: a property, or a literal.
struct TQueryOperand {
    std::string name;      ///< of the property; empty for a literal
    TCIMValue literal;     ///< string, uint64, sint64, real64, boolean or null
    std::size_t position;  ///< in the query's text
    std::size_t ordinal;   ///< counts the properties that the condition mentions
    bool isClass = false;  ///< the class of the query itself, which ISA may ask for
};

/// A condition of a query, as parsed; it knows no class yet.
struct TQueryCondition {
    enum EKind {
        kOr,   ///< over parts
        kAnd,  ///< over parts
        kNot,  ///< of the one in parts
        kEqual,
        kNotEqual,
        kLess,
        kLessOrEqual,
        kGreater,
        kGreaterOrEqual,
        kLike,    ///< operands[0] and pattern
        kIsNull,  ///< of operands[0]
        kIsA      ///< of operands[0] and className
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

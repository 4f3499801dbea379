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
    std::string fName;      ///< of the property; empty for a literal
    TCIMValue fLiteral;     ///< string, uint64, sint64, real64, boolean or null
    std::size_t fPosition;  ///< in the query's text
    std::size_t fOrdinal;   ///< counts the properties that the condition mentions
    bool fIsClass = false;  ///< the class of the query itself, which ISA may ask for
};

/// A condition of a query, as parsed; it knows no class yet.
class TQueryCondition {
  public:
    enum EKind {
        kOr,   ///< over fParts
        kAnd,  ///< over fParts
        kNot,  ///< of the one in fParts
        kEqual,
        kNotEqual,
        kLess,
        kLessOrEqual,
        kGreater,
        kGreaterOrEqual,
        kLike,    ///< fOperands[0] and fPattern
        kIsNull,  ///< of fOperands[0]
        kIsA      ///< of fOperands[0] and fClassName
    };

    explicit TQueryCondition(EKind kind, std::size_t position) noexcept : fKind(kind), fPosition(position) {}

    EKind fKind;
    std::size_t fPosition;
    std::vector<std::unique_ptr<TQueryCondition>> fParts;
    std::vector<TQueryOperand> fOperands;
    std::unique_ptr<TLikePattern> fPattern;
    std::string fClassName;
};

}  // namespace NORVZEL20

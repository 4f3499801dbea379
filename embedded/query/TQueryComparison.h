#pragma once

#include "embedded/query/TQueryCondition.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// How two values of a query compare.
class TQueryComparison {
  public:
    TQueryComparison() = delete;

    enum EResult {
        kLess,
        kEqual,
        kGreater,
        kUnordered,  ///< different, and neither is the less: a NaN, FALSE and TRUE
        kUnknown     ///< a null, an embedded object, a datetime with asterisks
    };

    /// Whether values of the two types compare at all; kNone stands for any. A text literal compares with what it can be read as,
    /// which IsReadable tells.
    static bool AreComparable(TCIMValue::TCIMType a, TCIMValue::TCIMType b);
    /// Whether values of the types have an order, beyond being equal or not.
    static bool AreOrdered(TCIMValue::TCIMType a, TCIMValue::TCIMType b);
    /// Whether a text literal reads as a value of `type`.
    static bool IsReadable(const TCIMValue& literal, TCIMValue::TCIMType type);

    /// Compares values of comparable types.
    static EResult Compare(const TCIMValue& a, const TCIMValue& b);
};

}  // namespace NORVZEL20

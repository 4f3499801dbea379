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
        kUnordered,  ///< different, but neither is less: NaN and a number, FALSE and TRUE
        kUnknown     ///< a null, an embedded object, a datetime with asterisks
    };

    /// Whether values of the two types can be compared; kNone stands for any type. For a text literal and a datetime, IsReadable
    /// must be true as well.
    static bool AreComparable(TCIMValue::TCIMType a, TCIMValue::TCIMType b);
    /// Whether values of the types have an order, besides being equal or not.
    static bool AreOrdered(TCIMValue::TCIMType a, TCIMValue::TCIMType b);
    /// Whether a literal can be read as a value of `type`. Only a text for a datetime may be unreadable.
    static bool IsReadable(const TCIMValue& literal, TCIMValue::TCIMType type);

    /// Compares values of comparable types.
    static EResult Compare(const TCIMValue& a, const TCIMValue& b);
};

}  // namespace NORVZEL20

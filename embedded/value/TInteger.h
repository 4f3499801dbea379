#pragma once

#include <cstdint>

#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

/// An integer of any CIM type: its size and on which side of zero it is. Converts between the types without loss or not at all.
struct TInteger {
    std::uint64_t fMagnitude;
    bool fIsNegative;

    static bool IsOfInteger(TCIMValue::TCIMType::ECIMType type) noexcept
    {
        return type >= TCIMValue::TCIMType::kUint8 && type <= TCIMValue::TCIMType::kSint64;
    }
    static bool IsOfSigned(TCIMValue::TCIMType::ECIMType type) noexcept
    {
        return IsOfInteger(type) && (type - TCIMValue::TCIMType::kUint8) % 2 == 1;
    }

    /// Of a value of an integer type that is not null.
    static TInteger Read(const TCIMValue& value) noexcept;

    /// A value of the integer type `type`. False, with `result` as it is, where the number lies outside of its range.
    bool Make(TCIMValue::TCIMType::ECIMType type, TCIMValue& result) const noexcept;
};

}  // namespace NORVZEL20

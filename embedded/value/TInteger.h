#pragma once

#include <cstdint>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// An integer of any CIM type as magnitude and sign. It converts between the types only without loss.
struct TInteger {
    std::uint64_t magnitude;
    bool isNegative;

    /// The number of a value that has an integer type and is not null.
    static TInteger Read(const TCIMValue& value) noexcept;

    /// Makes a value of the integer type `type`. Returns false, and leaves `result` as it is, if the number is out of range.
    bool Make(TCIMValue::TCIMType::ECIMType type, TCIMValue& result) const noexcept;
};

}  // namespace NORVZEL20

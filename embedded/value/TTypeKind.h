#pragma once

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// What kind of values a type has. An array type is of no kind.
class TTypeKind {
  public:
    using EType = TCIMValue::TCIMType::ECIMType;

    TTypeKind() = delete;

    static constexpr bool IsInteger(EType type) noexcept
    {
        return type >= TCIMValue::TCIMType::kUint8 && type <= TCIMValue::TCIMType::kSint64;
    }
    /// The codes of the integer types alternate: uint8, sint8, uint16, sint16, ...
    static constexpr bool IsSigned(EType type) noexcept { return IsInteger(type) && (type - TCIMValue::TCIMType::kUint8) % 2 == 1; }
    static constexpr bool IsUnsigned(EType type) noexcept { return IsInteger(type) && !IsSigned(type); }
    static constexpr bool IsReal(EType type) noexcept
    {
        return type == TCIMValue::TCIMType::kReal32 || type == TCIMValue::TCIMType::kReal64;
    }
    static constexpr bool IsNumber(EType type) noexcept { return IsInteger(type) || IsReal(type); }
};

}  // namespace NORVZEL20

#include "embedded/value/TInteger.h"

#include <limits>

#include "embedded/value/TTypeKind.h"
#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

namespace {

struct TIntegerRange {
    std::int64_t least;
    std::uint64_t greatest;
};

template <class T>
constexpr TIntegerRange kRangeOf{std::numeric_limits<T>::min(), static_cast<std::uint64_t>(std::numeric_limits<T>::max())};

// In the order of the type codes, from uint8 to sint64.
constexpr TIntegerRange kIntegerRanges[] = {kRangeOf<std::uint8_t>,  kRangeOf<std::int8_t>,   kRangeOf<std::uint16_t>,
                                            kRangeOf<std::int16_t>,  kRangeOf<std::uint32_t>, kRangeOf<std::int32_t>,
                                            kRangeOf<std::uint64_t>, kRangeOf<std::int64_t>};

}  // namespace

// Unsigned arithmetic negates the least number of a type too, which has no positive counterpart.
TInteger TInteger::Read(const TCIMValue& value) noexcept
{
    const std::uint64_t bits = TValueAccess::GetBits(value);
    const bool isNegative = TTypeKind::IsSigned(value.GetType()) && (bits >> 63) != 0;
    return {isNegative ? static_cast<std::uint64_t>(0) - bits : bits, isNegative};
}

bool TInteger::Make(TCIMValue::TCIMType::ECIMType type, TCIMValue& result) const noexcept
{
    const TIntegerRange& range = kIntegerRanges[type - TCIMValue::TCIMType::kUint8];
    const std::uint64_t bound =
        isNegative ? static_cast<std::uint64_t>(0) - static_cast<std::uint64_t>(range.least) : range.greatest;
    if (magnitude > bound) {
        return false;
    }
    result = TValueAccess::FromBits(type, isNegative ? static_cast<std::uint64_t>(0) - magnitude : magnitude);
    return true;
}

}  // namespace NORVZEL20

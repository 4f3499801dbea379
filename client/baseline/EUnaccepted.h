#pragma once

namespace NORVZEL20 {

/// For which of its inventories a difference is not accepted.
enum class EUnaccepted : unsigned char { kNone, kSome, kAll };

}  // namespace NORVZEL20

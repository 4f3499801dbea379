#pragma once

namespace NORVZEL20 {

/// How the program ends, as `diff` does.
inline constexpr int kExitSuccess = 0;
inline constexpr int kExitDifferences = 1;  ///< of `compare` alone
inline constexpr int kExitTrouble = 2;

}  // namespace NORVZEL20

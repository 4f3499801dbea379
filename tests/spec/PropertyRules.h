#pragma once

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// The two rules for a property, by their short names.
inline constexpr auto INCLUDE = TCIMDiffEngine::INCLUDE;
inline constexpr auto EXCLUDE = TCIMDiffEngine::EXCLUDE;

}  // namespace NORVZEL20

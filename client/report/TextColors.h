#pragma once

#include <string>

#include "client/comparison/TDifference.h"

namespace NORVZEL20 {

// Escape sequences for a terminal.
inline constexpr char kBold[] = "\x1b[1m";
inline constexpr char kRed[] = "\x1b[31m";
inline constexpr char kGreen[] = "\x1b[32m";
inline constexpr char kYellow[] = "\x1b[33m";

/// The colour of lines about differences of that kind.
inline const char* ColorOf(TDifference::EKind kind)
{
    switch (kind) {
    case TDifference::kOnlyInReference:
        return kRed;
    case TDifference::kOnlyInOthers:
        return kGreen;
    default:
        return kYellow;
    }
}

/// The text in that colour, or as it is if the report is not coloured.
inline std::string Paint(bool isColored, const char* color, const std::string& text)
{
    return isColored ? color + text + "\x1b[0m" : text;
}

}  // namespace NORVZEL20

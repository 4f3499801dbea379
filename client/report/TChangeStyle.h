#pragma once

#include <cstddef>

#include "client/text/TValueWords.h"

namespace NORVZEL20 {

/// How ChangeText writes a change.
struct TChangeStyle {
    bool isPair = false;                 ///< whether nobody needs to be named behind the values
    bool isWhole = false;                ///< whether long texts are not cut
    std::size_t mostValues = 8;          ///< how many values are written; the others are counted
    const TValueWords* words = nullptr;  ///< for the values of the property, if there are any
    /// What shows all values, as the report names it.
    const char* detailOption = "--detail";
};

}  // namespace NORVZEL20

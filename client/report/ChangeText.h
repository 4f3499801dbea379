#pragma once

#include <string>

#include "client/comparison/TValueDifference.h"
#include "client/report/TChangeStyle.h"
#include "client/report/TInventoryNames.h"

namespace NORVZEL20 {

/// What changed, for people: `500 -> 250`, or of several inventories `500 -> 250 (web02) / NULL (web03..05)`.
///
/// Of an array of texts, only what came and went, if some of it stayed in its order: `-noexec +nodev`. Long texts are cut around
/// what differs. Values that would then look alike are written whole.
std::string ChangeText(const TValueDifference& change, const TInventoryNames& names, const TChangeStyle& style);

/// The same without words for the values.
inline std::string ChangeText(const TValueDifference& change, const TInventoryNames& names, bool isPair)
{
    TChangeStyle style;
    style.isPair = isPair;
    return ChangeText(change, names, style);
}

}  // namespace NORVZEL20

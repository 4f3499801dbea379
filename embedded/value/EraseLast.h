#pragma once

#include <algorithm>
#include <iterator>
#include <vector>

namespace NORVZEL20 {

/// Removes the last element for which `isIt` is true. It searches from the end: removing what was added last costs little.
template <class T, class TMatch>
void EraseLast(std::vector<T>& list, const TMatch& isIt)
{
    const auto at = std::find_if(list.rbegin(), list.rend(), isIt);
    if (at != list.rend()) {
        list.erase(std::next(at).base());
    }
}

}  // namespace NORVZEL20

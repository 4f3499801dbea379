#pragma once

#include <algorithm>
#include <iterator>
#include <vector>

namespace NORVZEL20 {

/// Takes the last element out for which `isIt` is true. Looks from the end, so that taking back what was added last costs little.
template <class T, class TMatch>
void EraseLast(std::vector<T>& list, const TMatch& isIt)
{
    const auto at = std::find_if(list.rbegin(), list.rend(), isIt);
    if (at != list.rend()) {
        list.erase(std::next(at).base());
    }
}

}  // namespace NORVZEL20

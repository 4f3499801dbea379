#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <utility>
#include <vector>

#include "client/comparison/TDifference.h"

namespace NORVZEL20 {

/// Numbers the groups of instances that came or went, from 0: those of the same kind in the same inventories are one group.
/// `TLess` orders sets of inventories.
template <class TLess = std::less<>>
class TPresencePlaces {
  public:
    explicit TPresencePlaces(const TLess& less = TLess()) : fPlaces{TPlaces(less), TPlaces(less), TPlaces(less)} {}

    /// The number of the difference's group, and whether it is a new one. Cost: a search in a tree of all groups of the kind.
    std::pair<std::size_t, bool> Add(const TDifference& difference)
    {
        const auto [known, isNew] = fPlaces[difference.kind].emplace(difference.inventories, fCount);
        fCount += isNew ? 1 : 0;
        return {known->second, isNew};
    }

  private:
    using TPlaces = std::map<std::vector<std::size_t>, std::size_t, TLess>;

    TPlaces fPlaces[TDifference::kChanged + 1];
    std::size_t fCount = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <unordered_map>
#include <vector>

#include "client/comparison/TValueDifference.h"

namespace NORVZEL20 {

/// The values of a difference while it is being made: equal ones come into one group.
///
/// Groups stand in the order in which their first values came. Cost: a constant number of comparisons for each value, however many
/// groups there are.
class TValueGroups {
  public:
    /// The same number for equal values.
    using THash = boost::function<std::size_t(const TCIMValue&)>;

    /// `difference` must outlive this and have no groups yet.
    TValueGroups(TValueDifference& difference, const TValueDifference::TEqual& areEqual, const THash& hash)
        : fGroups(difference.others), fAreEqual(areEqual), fHash(hash)
    {}

    /// The group of `value`, added if there is none yet. A null is equal to a null of another type, but a group has one type,
    /// so that it can be shown.
    TValueDifference::TGroup& Get(const TCIMValue& value);
    /// Whether not all values are equal.
    bool Differ() const;

  private:
    std::size_t Find(const TCIMValue& value);

    std::vector<TValueDifference::TGroup>& fGroups;
    TValueDifference::TEqual fAreEqual;
    THash fHash;
    std::unordered_multimap<std::size_t, std::size_t> fByHash;  // positions of groups; empty as long as there are few
};

}  // namespace NORVZEL20

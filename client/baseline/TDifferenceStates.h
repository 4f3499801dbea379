#pragma once

#include <string>
#include <vector>

#include "client/comparison/TAcceptedDifference.h"
#include "client/comparison/TDifference.h"

namespace NORVZEL20 {

/// What stands in the place of a property before the number of instances that share a key.
inline constexpr char kInstancesMark[] = "(instances)";

/// A difference as a baseline sees it: what it is about, and the state of each inventory concerned.
class TDifferenceStates {
  public:
    /// The difference must outlive this.
    explicit TDifferenceStates(const TDifference& difference);

    /// The class and the key. Of an instance of the reference whose class excludes keys all its keys, since others have the rest.
    const std::string& GetInstance() const { return fInstance; }
    /// The property of kChanged; otherwise empty.
    std::string GetProperty() const;
    /// What TAcceptedDifference::values says of one of the difference's inventories.
    std::vector<TAcceptedDifference::TValue> ValuesOf(std::size_t inventory) const;

  private:
    std::vector<TAcceptedDifference::TValue> ContentsOf(std::size_t inventory) const;

    const TDifference& fDifference;
    std::string fInstance;
};

}  // namespace NORVZEL20

#pragma once

#include "embedded/load/TTextPlace.h"

namespace NORVZEL20 {

/// A reader that knows how far it has come in its document.
class IPlaceSource {
  public:
    virtual ~IPlaceSource() = default;

    /// The place of what is being read. Cost: at most linear in what was read since the last call.
    virtual TTextPlace GetPlace() const = 0;
};

}  // namespace NORVZEL20

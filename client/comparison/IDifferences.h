#pragma once

#include <functional>

#include "client/comparison/TDifference.h"
#include "client/comparison/TDifferenceCounts.h"

namespace NORVZEL20 {

/// The differences of a comparison, read one after the other. What selects some of them, or sees them from another reference, reads
/// one such list and is another.
///
/// Threads: one at a time.
class IDifferences {
  public:
    using TCallback = std::function<void(const TDifference&)>;

    virtual ~IDifferences() = default;

    virtual TDifferenceCounts GetCounts() const = 0;

    /// Calls back with each difference: by class name, then instance, then property. It is valid during the callback. May be called
    /// several times, and calls back with the same each time.
    /// Errors: TZELException of a namespace; std::bad_alloc; what the callback throws.
    virtual void ForEach(const TCallback& callback) = 0;
};

}  // namespace NORVZEL20

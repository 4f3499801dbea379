#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// Watches xz data go by and knows whether something else follows it. The library that decompresses the data reports this as
/// damage, or as an early end, like faults within the data.
class TXzEnd {
  public:
    /// The next piece of the data, which may have any length. Errors: std::bad_alloc. Cost: one search.
    void Watch(std::string_view piece);

    /// Whether a stream has ended and what came behind it is neither padding nor the beginning of another stream.
    bool HasOtherData() const;

  private:
    bool fEnded = false;
    std::string fLast;    // the end of what went by, shorter than a footer
    std::string fBehind;  // what followed the last footer, as far as it is needed
};

}  // namespace NORVZEL20

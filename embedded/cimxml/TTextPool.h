#pragma once

#include <array>
#include <cstdint>
#include <string_view>

#include "embedded/value/TSharedText.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Makes string values and lets values of the same text share it, as far as that is cheap.
///
/// The pool keeps a bounded number of texts and does not promise to share. Text that does not repeat replaces nothing in it.
/// Threads: one at a time. Errors: std::bad_alloc.
class TTextPool {
  public:
    TCIMValue MakeValue(std::string_view text);

  private:
    static constexpr std::size_t kBuckets = 1024;
    static constexpr std::size_t kLongest = 512;  // longer text hardly ever repeats

    struct TBucket {
        std::uint32_t hash = 0;  // of the text kept
        std::uint32_t last = 0;  // hash of the last text that was not kept
        TSharedText::TPointer text;
    };

    std::array<TBucket, kBuckets> fBuckets;
};

}  // namespace NORVZEL20

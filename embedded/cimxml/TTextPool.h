#pragma once

#include <array>
#include <cstdint>
#include <string_view>

#include "embedded/value/TSharedText.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Makes string values, and lets values of the same text share it: inventories repeat themselves.
///
/// Keeps a text from the second time on that it meets it, one in each bucket, so it neither grows nor promises to share; text that
/// does not repeat passes through without touching what is kept. Not for several threads at once.
class TTextPool {
  public:
    TCIMValue MakeValue(std::string_view text);

  private:
    static constexpr std::size_t kBuckets = 1024;
    static constexpr std::size_t kLongest = 512;  // longer text hardly repeats

    struct TBucket {
        std::uint32_t hash = 0;  // of the text kept
        std::uint32_t last = 0;  // hash of the last text that was not kept
        TSharedText::TPointer text;
    };

    std::array<TBucket, kBuckets> fBuckets;
};

}  // namespace NORVZEL20

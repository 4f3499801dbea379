#pragma once

#include <array>
#include <cstdint>
#include <string_view>

#include "embedded/value/TSharedText.h"
#include "embedded/value/TTextRun.h"
#include "host/Export.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Makes string values and lets values of the same text share it, as far as that is cheap.
///
/// The pool keeps a bounded number of texts and does not promise to share. Text that does not repeat replaces nothing in it; it
/// goes into a TTextRun together with its neighbours. Values may outlive the pool.
/// Threads: one at a time. Errors: std::bad_alloc.
class CIMDELTA_INTERNAL_EXPORT TTextPool {
  public:
    TCIMValue MakeValue(std::string_view text);

  private:
    static constexpr std::size_t kBuckets = 1024;

    struct TBucket {
        std::uint32_t hash = 0;  // of the text kept
        std::uint32_t last = 0;  // hash of the last text that was not kept
        TSharedText::TPointer text;
    };

    TCIMValue MakeInRun(std::string_view text);

    std::array<TBucket, kBuckets> fBuckets;
    TTextRun::TPointer fRun;  // the one that is being filled, or null
};

}  // namespace NORVZEL20

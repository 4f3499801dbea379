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
    TTextPool() = default;
    TTextPool(const TTextPool&) = delete;
    TTextPool& operator=(const TTextPool&) = delete;

    TCIMValue MakeValue(std::string_view text);

    /// From now on, texts that do not repeat go into `run`. It may be null at first, and is replaced when it is full. A null
    /// pointer to it means the pool's own run. It must live until the next call of this or the last one of MakeValue.
    void FillRun(TTextRun::TPointer* run) noexcept { fFilled = run != nullptr ? run : &fRun; }

  private:
    static constexpr std::size_t kBuckets = 1024;
    static constexpr std::size_t kFirstRunSize = 1024;  // of a run that the caller gives; its successors have a page

    struct TBucket {
        std::uint32_t hash = 0;  // of the text kept
        std::uint32_t last = 0;  // hash of the last text that was not kept
        TSharedText::TPointer text;
    };

    TCIMValue MakeInRun(std::string_view text);

    std::array<TBucket, kBuckets> fBuckets;
    TTextRun::TPointer fRun;  // the last of the pool's own, or null
    TTextRun::TPointer* fFilled = &fRun;
};

}  // namespace NORVZEL20

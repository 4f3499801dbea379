#pragma once

#include <array>
#include <string_view>

#include "embedded/TSharedText.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Makes string values, and lets values of the same text share it: inventories repeat themselves.
///
/// Remembers the last text of each bucket alone, so it neither grows nor promises to share. Not for several threads at once.
class TTextPool {
  public:
    TCIMValue MakeValue(std::string_view text);

  private:
    static constexpr std::size_t kBuckets = 4096;
    static constexpr std::size_t kLongest = 512;  // longer text hardly repeats

    std::array<TSharedText::TPointer, kBuckets> fTexts;
};

}  // namespace NORVZEL20

#pragma once

#include <string_view>
#include <vector>

#include "client/inventory/TOwnName.h"
#include "embedded/store/TKeyTexts.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Writes the names of systems in keys and references as the reference has them, and counts what it does.
class TNameReplacement {
  public:
    /// `names` gets the counts and must outlive this.
    explicit TNameReplacement(std::vector<TOwnName>& names) noexcept : fNames(names) {}

    /// What takes the text's place; null if it stays. Different texts stay different, spellings of one name aside.
    TCIMValue Replace(std::string_view text, const TKeyTexts::TPlace& place);

  private:
    std::vector<TOwnName>& fNames;
};

}  // namespace NORVZEL20

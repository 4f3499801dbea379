#pragma once

#include <string_view>

namespace NORVZEL20 {

/// Whether the whole name is what the pattern describes: `*` stands for any characters, none included, and `?` for one. The letter
/// case of ASCII letters does not matter. Cost: the product of the two lengths at most.
bool MatchesWildcards(std::string_view pattern, std::string_view name);

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// The word that a person probably meant by `typed`: the first of the words that begin with it, or else the one that fewest slips
/// of the keyboard turn into it. A slip leaves out, adds or replaces a character, or swaps two neighbours; one slip is allowed for
/// each three characters of the word. Returns an empty text if no word is near, or if fewer than two characters were typed. Dashes
/// in front do not count as characters, neither of the three nor of the two.
std::string NearestWord(const std::string& typed, const std::vector<std::string>& words);

}  // namespace NORVZEL20

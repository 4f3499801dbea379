#pragma once

#include <fnmatch.h>

#include <algorithm>
#include <iterator>
#include <string>

namespace NORVZEL20 {

/// Whether the whole text is what one of the shell patterns describes. An asterisk also stands for slashes.
template <class TPatterns>
bool MatchesAny(const std::string& text, const TPatterns& patterns)
{
    // The first character of a pattern is where it begins, whether it is a std::string or a literal.
    return std::any_of(std::begin(patterns), std::end(patterns),
                       [&text](const auto& pattern) { return fnmatch(&pattern[0], text.c_str(), 0) == 0; });
}

}  // namespace NORVZEL20

#include "client/text/MatchesWildcards.h"

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

// If the characters after a star do not fit, the star takes one character more. Only the last star is tried again: what stands
// before it has been found as early as possible.
bool MatchesWildcards(std::string_view pattern, std::string_view name)
{
    std::size_t star = std::string_view::npos;
    std::size_t taken = 0;  // where the name goes on behind what the star stands for
    std::size_t p = 0;
    std::size_t n = 0;
    while (n < name.size()) {
        if (p < pattern.size() && pattern[p] == '*') {
            star = p++;
            taken = n;
        } else if (p < pattern.size() && (pattern[p] == '?' || TNameText::ToLower(pattern[p]) == TNameText::ToLower(name[n]))) {
            ++p;
            ++n;
        } else if (star != std::string_view::npos) {
            p = star + 1;
            n = ++taken;
        } else {
            return false;
        }
    }
    return pattern.find_first_not_of('*', p) == std::string_view::npos;
}

}  // namespace NORVZEL20

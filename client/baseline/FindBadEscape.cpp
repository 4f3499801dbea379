#include "client/baseline/FindBadEscape.h"

#include <algorithm>
#include <string>

#include "client/baseline/FindEndOfQuoted.h"

namespace NORVZEL20 {

namespace {

// The number of characters of the escape at the beginning of the text; 0 if it is none.
std::size_t LengthOfEscape(std::string_view text, char quote)
{
    const char kind = text.size() > 1 ? text[1] : '\0';
    if (kind == quote || kind == '\\' || kind == 'n' || kind == 'r' || kind == 't') {
        return 2;
    }
    const std::size_t digits = kind == 'x' ? 2 : kind == 'u' ? 4 : 0;
    const std::string_view code = text.substr(std::min<std::size_t>(2, text.size()), digits);
    const bool isWhole =
        digits > 0 && code.size() == digits && code.find_first_not_of("0123456789abcdef") == std::string_view::npos;
    return isWhole ? 2 + digits : 0;
}

}  // namespace

std::size_t FindBadEscape(std::string_view text)
{
    std::size_t open = text.find_first_of("\"'");
    while (open != std::string_view::npos) {
        const std::size_t end = FindEndOfQuoted(text, open);
        for (std::size_t at = text.find('\\', open); at < end;) {
            const std::size_t length = LengthOfEscape(text.substr(at), text[open]);
            if (length == 0) {
                return at;
            }
            at = text.find('\\', at + length);
        }
        open = end == std::string_view::npos ? end : text.find_first_of("\"'", end + 1);
    }
    return std::string_view::npos;
}

}  // namespace NORVZEL20

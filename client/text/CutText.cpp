#include "client/text/CutText.h"

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

std::string CutText(std::string_view text, std::size_t most)
{
    return std::string(TUtf8::Shorten(text, most)) + (text.size() > most ? "..." : "");
}

}  // namespace NORVZEL20

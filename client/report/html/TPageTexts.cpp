#include "client/report/html/TPageTexts.h"

#include "client/report/html/LittleEndian.h"
#include "client/text/DisplayText.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

// A character above U+FFFF, the only ones of four bytes, takes two units.
std::size_t LengthInUtf16(std::string_view text)
{
    std::size_t length = 0;
    for (const char byte : text) {
        length += TUtf8::IsContinuation(byte) ? 0 : 1;
        length += static_cast<unsigned char>(byte) >= 0xF0U ? 1 : 0;
    }
    return length;
}

}  // namespace

TPageTexts::TPageTexts()
{
    Add(std::string_view());
}

std::uint32_t TPageTexts::Add(std::string_view text)
{
    std::string valid(text);
    if (TUtf8::FindInvalid(text) < text.size()) {
        valid = EscapeForDisplay(text);
    }
    const auto [known, isNew] = fNumbers.emplace(std::move(valid), static_cast<std::uint32_t>(fNumbers.size()));
    if (isNew) {
        fTexts.Append(known->first);
        AppendNumber(fLengths, LengthInUtf16(known->first));
    }
    return known->second;
}

}  // namespace NORVZEL20

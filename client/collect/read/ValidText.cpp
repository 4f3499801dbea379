#include "client/collect/read/ValidText.h"

#include "embedded/value/IsXmlCharacter.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

void AppendHexadecimal(std::string& out, std::string_view bytes)
{
    constexpr char kDigits[] = "0123456789ABCDEF";
    for (const char byte : bytes) {
        const auto code = static_cast<unsigned char>(byte);
        out += "\\x";
        out += kDigits[code >> 4U];
        out += kDigits[code & 0xFU];
    }
}

}  // namespace

std::string ValidText(std::string_view bytes)
{
    std::string text;
    text.reserve(bytes.size());
    while (!bytes.empty()) {
        const TUtf8::TCharacter character = TUtf8::Decode(bytes);
        const bool isValid = character.IsValid();
        const std::string_view piece = bytes.substr(0, isValid ? character.length : 1);
        if (isValid && IsXmlCharacter(character.code)) {
            text += piece;
        } else {
            AppendHexadecimal(text, piece);
        }
        bytes.remove_prefix(piece.size());
    }
    return text;
}

}  // namespace NORVZEL20

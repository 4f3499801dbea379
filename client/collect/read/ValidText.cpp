#include "client/collect/read/ValidText.h"

#include <boost/algorithm/hex.hpp>

#include "embedded/value/IsXmlCharacter.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

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
            for (const char byte : piece) {
                text += "\\x" + boost::algorithm::hex(std::string(1, byte));
            }
        }
        bytes.remove_prefix(piece.size());
    }
    return text;
}

}  // namespace NORVZEL20

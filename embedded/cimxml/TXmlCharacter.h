#pragma once

#include <array>
#include <cstddef>
#include <string_view>

#include "embedded/cimxml/EXmlScan.h"
#include "embedded/value/IsXmlCharacter.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

/// Questions about the characters of XML. Those about names know ASCII only: the tokenizer leaves other names to Expat.
class TXmlCharacter {
  public:
    TXmlCharacter() = delete;

    /// Whether XML counts the character as white space.
    static bool IsBlank(char c) noexcept { return (Get(c) & kBlank) != 0; }
    static bool IsNameStart(char c) noexcept { return (Get(c) & kNameStart) != 0; }
    static bool IsNamePart(char c) noexcept { return (Get(c) & kNamePart) != 0; }

    /// Moves `at` over the UTF-8 character that begins there, unless the bytes end within it or a document may not contain it.
    static EXmlScan Pass(const char*& at, const char* end) noexcept
    {
        constexpr std::ptrdiff_t kLongest = 4;
        const TUtf8::TCharacter character = TUtf8::Decode(std::string_view(at, static_cast<std::size_t>(end - at)));
        if (character.IsValid() && IsXmlCharacter(character.code)) {
            at += character.length;
            return EXmlScan::kAccepted;
        }
        return end - at < kLongest ? EXmlScan::kCutOff : EXmlScan::kRefused;
    }

  private:
    enum EKind : unsigned char { kBlank = 1, kNameStart = 2, kNamePart = 4 };

    static constexpr std::array<unsigned char, 256> MakeKinds()
    {
        std::array<unsigned char, 256> kinds{};
        for (const char c : std::string_view(" \t\n\r")) {
            kinds[static_cast<unsigned char>(c)] = kBlank;
        }
        for (const char c : std::string_view("abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ_:")) {
            kinds[static_cast<unsigned char>(c)] = kNameStart | kNamePart;
        }
        for (const char c : std::string_view("0123456789-.")) {
            kinds[static_cast<unsigned char>(c)] = kNamePart;
        }
        return kinds;
    }

    static unsigned char Get(char c) noexcept
    {
        static constexpr std::array<unsigned char, 256> kKinds = MakeKinds();
        return kKinds[static_cast<unsigned char>(c)];
    }
};

}  // namespace NORVZEL20

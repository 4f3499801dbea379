#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace NORVZEL20 {

/// Guesses at the slot of a property, from the length and a few characters of its name. They spare most look-ups by name the hash.
///
/// A name has two entries. If another name has the first one, the slot goes into the second, and replaces what is there. The caller
/// must check that the slot guessed is the one that it looks for.
class TLikelySlots {
  public:
    static constexpr std::uint32_t kNone = 0xffffffff;

    /// kNone if there is no guess. The same for names that differ only in letter case.
    std::uint32_t Guess(std::string_view name) const noexcept { return fSlots[FirstEntryOf(name)] - 1U; }
    /// The same, for a name whose first guess was wrong.
    std::uint32_t GuessAgain(std::string_view name) const noexcept { return fSlots[SecondEntryOf(name)] - 1U; }

    /// Slots beyond 254 are left out.
    void Add(std::string_view name, std::uint32_t slot) noexcept
    {
        if (slot < 255) {
            const std::size_t first = FirstEntryOf(name);
            fSlots[fSlots[first] == 0 ? first : SecondEntryOf(name)] = static_cast<std::uint8_t>(slot + 1);
        }
    }

    /// From now on `slot` is not guessed for `name`.
    void Remove(std::string_view name, std::uint32_t slot) noexcept
    {
        for (const std::size_t entry : {FirstEntryOf(name), SecondEntryOf(name)}) {
            if (fSlots[entry] - 1U == slot) {
                fSlots[entry] = 0;
            }
        }
    }

  private:
    static constexpr std::size_t kEntries = 128;

    // With this bit set, upper case is lower case. Other characters may become equal too, which only makes a worse guess.
    static std::size_t LowerAt(std::string_view name, std::size_t index) noexcept
    {
        return static_cast<std::size_t>(static_cast<unsigned char>(name[index]) | 0x20U);
    }

    static std::size_t FirstEntryOf(std::string_view name) noexcept
    {
        if (name.empty()) {
            return 0;
        }
        return (name.size() * 7 + LowerAt(name, 0) * 3 + LowerAt(name, name.size() / 2) * 11 + LowerAt(name, name.size() - 1) * 5) %
               kEntries;
    }

    static std::size_t SecondEntryOf(std::string_view name) noexcept
    {
        if (name.empty()) {
            return 1;
        }
        return (name.size() * 5 + LowerAt(name, name.size() / 3) * 7 + LowerAt(name, name.size() * 2 / 3) * 13 +
                LowerAt(name, name.size() * 3 / 4) * 3) %
               kEntries;
    }

    std::array<std::uint8_t, kEntries> fSlots{};  // the slot plus one, 0 for none
};

}  // namespace NORVZEL20

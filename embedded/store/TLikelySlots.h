#pragma once

#include <array>
#include <cstdint>
#include <string_view>

namespace NORVZEL20 {

/// A guess at the slot of a property, from the length and three characters of its name. It spares most look-ups by name the hash.
///
/// Several names may share an entry, which then has the slot that was added last. The caller must check that the slot guessed is
/// the one that it looks for.
class TLikelySlots {
  public:
    static constexpr std::uint32_t kNone = 0xffffffff;

    /// kNone if there is no guess. The same for names that differ only in letter case.
    std::uint32_t Guess(std::string_view name) const noexcept { return fSlots[EntryOf(name)] - 1U; }

    /// Slots beyond 254 are left out.
    void Add(std::string_view name, std::uint32_t slot) noexcept
    {
        if (slot < 255) {
            fSlots[EntryOf(name)] = static_cast<std::uint8_t>(slot + 1);
        }
    }

    /// From now on `slot` is not guessed for `name`.
    void Remove(std::string_view name, std::uint32_t slot) noexcept
    {
        if (Guess(name) == slot) {
            fSlots[EntryOf(name)] = 0;
        }
    }

  private:
    static constexpr std::size_t kEntries = 64;

    static std::size_t EntryOf(std::string_view name) noexcept
    {
        if (name.empty()) {
            return 0;
        }
        // With this bit set, upper case is lower case. Other characters may become equal too, which only makes a worse guess.
        const auto at = [name](std::size_t index) {
            return static_cast<std::size_t>(static_cast<unsigned char>(name[index]) | 0x20U);
        };
        return (name.size() * 7 + at(0) * 3 + at(name.size() / 2) * 11 + at(name.size() - 1) * 5) % kEntries;
    }

    std::array<std::uint8_t, kEntries> fSlots{};  // the slot plus one, 0 for none
};

}  // namespace NORVZEL20

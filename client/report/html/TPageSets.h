#pragma once

#include <cstdint>
#include <map>
#include <vector>

namespace NORVZEL20 {

/// The sets of inventories that a page speaks of, each once. A set is known by its number; 0 is the empty set.
class TPageSets {
  public:
    TPageSets() { Add({}); }

    /// The number of the set. `inventories` are ascending.
    std::uint32_t Add(const std::vector<std::size_t>& inventories)
    {
        const auto [known, isNew] = fNumbers.emplace(inventories, static_cast<std::uint32_t>(fSets.size()));
        if (isNew) {
            fSets.push_back(&known->first);
        }
        return known->second;
    }

    const std::vector<std::size_t>& Get(std::uint32_t number) const { return *fSets[number]; }
    std::size_t GetCount() const { return fSets.size(); }

  private:
    std::map<std::vector<std::size_t>, std::uint32_t> fNumbers;
    std::vector<const std::vector<std::size_t>*> fSets;
};

}  // namespace NORVZEL20

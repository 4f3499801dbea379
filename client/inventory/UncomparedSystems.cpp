#include "client/inventory/UncomparedSystems.h"

#include <algorithm>

namespace NORVZEL20 {

std::vector<std::size_t> FindMadeSystems(const std::vector<TSchemaNote>& notes)
{
    std::vector<std::size_t> positions;
    for (const TSchemaNote& note : notes) {
        if (note.kind == TSchemaNote::kOperatingSystemMade) {
            positions.push_back(note.inventory);
        }
    }
    std::sort(positions.begin(), positions.end());
    return positions;
}

bool IsNoSystemCompared(const std::vector<TSchemaNote>& notes, std::size_t inventories)
{
    const std::vector<std::size_t> made = FindMadeSystems(notes);
    return !made.empty() && (made.front() == 0 || made.size() == inventories - 1);
}

}  // namespace NORVZEL20

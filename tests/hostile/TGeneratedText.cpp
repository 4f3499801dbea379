#include "tests/hostile/TGeneratedText.h"

#include <algorithm>

namespace NORVZEL20 {

TGeneratedText::TGeneratedText(std::string beginning, const std::string& unit, std::uint64_t times, std::string end)
    : fBeginning(std::move(beginning)), fUnitSize(unit.size()), fMiddleSize(unit.size() * times), fEnd(std::move(end))
{
    constexpr std::size_t kBlockSize = 64 * 1024;
    while (fUnits.size() < kBlockSize && fUnits.size() < fMiddleSize) {
        fUnits += unit;
    }
}

/// The text from the position on, as far as it is in one piece.
std::string_view TGeneratedText::At(std::uint64_t position) const
{
    if (position < fBeginning.size()) {
        return std::string_view(fBeginning).substr(static_cast<std::size_t>(position));
    }
    position -= fBeginning.size();
    if (position < fMiddleSize) {
        const std::string_view units = std::string_view(fUnits).substr(static_cast<std::size_t>(position % fUnitSize));
        return units.substr(0, static_cast<std::size_t>(std::min<std::uint64_t>(units.size(), fMiddleSize - position)));
    }
    return std::string_view(fEnd).substr(static_cast<std::size_t>(position - fMiddleSize));
}

std::size_t TGeneratedText::Pull(char* buffer, std::size_t size)
{
    std::size_t count = 0;
    while (count < size && fPulled < GetLength()) {
        const std::size_t copied = At(fPulled).copy(buffer + count, size - count);
        count += copied;
        fPulled += copied;
    }
    return count;
}

}  // namespace NORVZEL20

#include "tests/hostile/TGeneratedText.h"

#include <algorithm>

namespace NORVZEL20 {

char TGeneratedText::At(std::uint64_t position) const
{
    if (position < fBeginning.size())
        return fBeginning[position];
    position -= fBeginning.size();
    if (position < fUnit.size() * fTimes)
        return fUnit[position % fUnit.size()];
    return fEnd[position - fUnit.size() * fTimes];
}

std::size_t TGeneratedText::Pull(char* buffer, std::size_t size)
{
    const std::size_t count = static_cast<std::size_t>(std::min<std::uint64_t>(size, GetLength() - fPulled));
    for (std::size_t i = 0; i < count; ++i)
        buffer[i] = At(fPulled + i);
    fPulled += count;
    return count;
}

}  // namespace NORVZEL20

#include "client/TCoverage.h"

#include <algorithm>
#include <numeric>

namespace NORVZEL20 {

bool TCoverage::IsComplete() const
{
    return CountSharing() == 0 && std::all_of(classes.begin(), classes.end(),
                                              [](const TClass& cls) { return cls.state == kCompared && cls.leftOut.empty(); });
}

std::size_t TCoverage::CountClasses(EState state) const
{
    return static_cast<std::size_t>(
        std::count_if(classes.begin(), classes.end(), [state](const TClass& cls) { return cls.state == state; }));
}

std::size_t TCoverage::CountCompared(std::size_t inventory) const
{
    std::size_t count = 0;
    for (const TClass& cls : classes) {
        count += cls.state == kCompared ? cls.instances[inventory] : 0;
    }
    return count;
}

std::size_t TCoverage::CountSharing() const
{
    std::size_t count = 0;
    for (const TClass& cls : classes) {
        count = std::accumulate(cls.sharing.begin(), cls.sharing.end(), count);
    }
    return count;
}

}  // namespace NORVZEL20

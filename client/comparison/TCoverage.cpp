#include "client/comparison/TCoverage.h"

#include <algorithm>
#include <numeric>

#include "provider/DeltaNames.h"

namespace NORVZEL20 {

bool TCoverage::IsComplete() const
{
    return IsComplete(true);
}

bool TCoverage::IsCompleteButForTimes() const
{
    return IsComplete(false);
}

bool TCoverage::IsComplete(bool timesCount) const
{
    return CountSharing() == 0 && std::all_of(classes.begin(), classes.end(),
                                              [this, timesCount](const TClass& cls) { return IsWholeClass(cls, timesCount); });
}

bool TCoverage::IsWholeClass(const TClass& cls, bool timesCount) const
{
    if (cls.state == kOperatingSystemMade) {
        // If every instance was made, none that came from an inventory is left out.
        const auto made = std::count_if(notes.begin(), notes.end(),
                                        [](const TSchemaNote& note) { return note.kind == TSchemaNote::kOperatingSystemMade; });
        return static_cast<std::size_t>(made) == cls.instances.size();
    }
    // Nothing of a compared class may be left out, except the time of collection if times do not count.
    return cls.state == kCompared && std::all_of(cls.leftOut.begin(), cls.leftOut.end(), [timesCount](const std::string& name) {
               return !timesCount && name == kCollectionTime;
           });
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

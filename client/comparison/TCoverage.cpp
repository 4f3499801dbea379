#include "client/comparison/TCoverage.h"

#include <algorithm>

#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

bool HasAny(const std::vector<std::size_t>& counts)
{
    return std::any_of(counts.begin(), counts.end(), [](std::size_t count) { return count > 0; });
}

// Nothing of a class may be left out, except the time of collection if times do not count.
bool IsWhole(const TCoverage::TClass& cls, bool timesCount)
{
    if (!cls.madeIn.empty()) {
        // If every instance was made, none that came from an inventory is left out.
        return !cls.HasOwnInstances();
    }
    return cls.state == TCoverage::kCompared && !HasAny(cls.sharing) && !cls.reducedReferences &&
           std::all_of(cls.leftOut.begin(), cls.leftOut.end(), [timesCount](const TCoverage::TLeftOut& leftOut) {
               return !timesCount && leftOut.property == kCollectionTime;
           });
}

}  // namespace

bool TCoverage::TClass::HasOwnInstances() const
{
    return HasAny(instances);
}

bool TCoverage::TClass::IsCompared() const
{
    return HasAny(compared);
}

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
    return !IsNothingCompared() && badValues.empty() && lacks.empty() &&
           std::all_of(classes.begin(), classes.end(), [timesCount](const TClass& cls) { return IsWhole(cls, timesCount); });
}

bool TCoverage::IsNothingCompared() const
{
    return CountComparedClasses() == 0;
}

std::size_t TCoverage::CountComparedClasses() const
{
    return static_cast<std::size_t>(
        std::count_if(classes.begin(), classes.end(), [](const TClass& cls) { return cls.IsCompared(); }));
}

std::size_t TCoverage::CountCompared(std::size_t inventory) const
{
    std::size_t count = 0;
    for (const TClass& cls : classes) {
        count += cls.compared[inventory];
    }
    return count;
}

}  // namespace NORVZEL20

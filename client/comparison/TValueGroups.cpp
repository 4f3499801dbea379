#include "client/comparison/TValueGroups.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

// Nearly all differences have one group or two; for those an index would cost more than it saves.
const std::size_t kFewGroups = 8;

bool IsIn(const TValueDifference::TGroup& group, const TCIMValue& value, const TValueDifference::TEqual& areEqual)
{
    return group.value.GetType() == value.GetType() && areEqual(group.value, value);
}

}  // namespace

TValueDifference::TGroup& TValueGroups::Get(const TCIMValue& value)
{
    const std::size_t found = Find(value);
    if (found < fGroups.size()) {
        return fGroups[found];
    }
    fGroups.push_back({{}, value, {}});
    if (fGroups.size() == kFewGroups) {
        for (std::size_t at = 0; at < fGroups.size(); ++at) {
            fByHash.emplace(fHash(fGroups[at].value), at);
        }
    } else if (fGroups.size() > kFewGroups) {
        fByHash.emplace(fHash(value), found);
    }
    return fGroups.back();
}

// The number of groups if the value is in none.
std::size_t TValueGroups::Find(const TCIMValue& value)
{
    if (fByHash.empty()) {
        const auto found = std::find_if(fGroups.begin(), fGroups.end(),
                                        [&](const TValueDifference::TGroup& group) { return IsIn(group, value, fAreEqual); });
        return static_cast<std::size_t>(found - fGroups.begin());
    }
    const auto candidates = fByHash.equal_range(fHash(value));
    const auto found = std::find_if(candidates.first, candidates.second,
                                    [&](const auto& candidate) { return IsIn(fGroups[candidate.second], value, fAreEqual); });
    return found == candidates.second ? fGroups.size() : found->second;
}

bool TValueGroups::Differ() const
{
    return std::any_of(fGroups.begin(), fGroups.end(),
                       [this](const TValueDifference::TGroup& group) { return !fAreEqual(fGroups.front().value, group.value); });
}

}  // namespace NORVZEL20

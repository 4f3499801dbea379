#include "client/baseline/ReduceDifference.h"

#include <algorithm>
#include <utility>

#include "client/comparison/PutContent.h"

namespace NORVZEL20 {

namespace {

TValueDifference::TGroup ReduceGroup(const TValueDifference::TGroup& group, const std::vector<std::size_t>& inventories)
{
    TValueDifference::TGroup reduced{{}, group.value, {}};
    for (std::size_t i = 0; i < group.inventories.size(); ++i) {
        if (std::binary_search(inventories.begin(), inventories.end(), group.inventories[i])) {
            reduced.Add(group.inventories[i], group.CountInstances(i));
        }
    }
    return reduced;
}

void ReduceValues(TValueDifference& values, const std::vector<std::size_t>& inventories)
{
    std::vector<TValueDifference::TGroup> groups;
    for (const TValueDifference::TGroup& group : values.others) {
        TValueDifference::TGroup reduced = ReduceGroup(group, inventories);
        if (!reduced.inventories.empty()) {
            groups.push_back(std::move(reduced));
        }
    }
    values.others = std::move(groups);
    for (TValueDifference& part : values.parts) {
        ReduceValues(part, inventories);
    }
    values.parts.erase(std::remove_if(values.parts.begin(), values.parts.end(),
                                      [](const TValueDifference& part) { return part.others.empty() && part.parts.empty(); }),
                       values.parts.end());
}

// The contents are those of the first inventory, which may be another one now.
void TakeContents(TDifference& difference, const TValueDifference& disagreement, std::size_t first, TPropertyOrder& order)
{
    const auto group =
        std::find_if(disagreement.others.begin(), disagreement.others.end(), [first](const TValueDifference::TGroup& candidate) {
            return std::binary_search(candidate.inventories.begin(), candidate.inventories.end(), first);
        });
    PutContent(difference, disagreement.property, group == disagreement.others.end() ? TCIMValue() : group->value, order);
}

}  // namespace

TDifference ReduceDifference(TDifference difference, const std::vector<std::size_t>& inventories, TPropertyOrder& order)
{
    const bool hasOtherFirst = difference.inventories.front() != inventories.front();
    difference.inventories = inventories;
    if (difference.kind == TDifference::kOnlyInOthers && hasOtherFirst) {
        for (const TValueDifference& disagreement : difference.values) {
            TakeContents(difference, disagreement, inventories.front(), order);
        }
    }
    for (TValueDifference& values : difference.values) {
        ReduceValues(values, inventories);
    }
    if (difference.kind == TDifference::kOnlyInOthers) {
        difference.values.erase(std::remove_if(difference.values.begin(), difference.values.end(),
                                               [](const TValueDifference& values) { return values.others.size() < 2; }),
                                difference.values.end());
    }
    return difference;
}

}  // namespace NORVZEL20

#include "client/comparison/TMajorityView.h"

#include <utility>

#include "client/comparison/TDifferenceCounter.h"
#include "client/comparison/TInstanceVotes.h"

namespace NORVZEL20 {

TMajorityView::TMajorityView(std::shared_ptr<IDifferences> differences, const std::vector<TInventory>& inventories,
                             const TCoverage& coverage)
    : fDifferences(std::move(differences)), fInventories(inventories)
{
    for (const TCoverage::TClass& cls : coverage.classes) {
        if (!cls.madeIn.empty()) {
            fUncompared.emplace(cls.name, cls.madeIn);
        }
    }
    TDifferenceCounter counter;
    ForEach([&counter](const TDifference& difference) { counter.Add(difference); });
    fCounts = counter.GetCounts();
}

void TMajorityView::ForEach(const TCallback& callback)
{
    std::vector<TDifference> ofInstance;
    TPropertyOrder order(fInventories.front());
    const auto handOn = [&] {
        for (const TDifference& difference : FromMajority(ofInstance, order)) {
            callback(difference);
        }
        ofInstance.clear();
    };
    fDifferences->ForEach([&](const TDifference& difference) {
        if (!ofInstance.empty() &&
            (ofInstance.front().className != difference.className || ofInstance.front().instance != difference.instance)) {
            handOn();
        }
        ofInstance.push_back(difference);
    });
    handOn();
}

std::vector<TDifference> TMajorityView::FromMajority(const std::vector<TDifference>& ofInstance, TPropertyOrder& order) const
{
    if (ofInstance.empty()) {
        return {};
    }
    const auto uncompared = fUncompared.find(ofInstance.front().className);
    return TInstanceVotes(ofInstance, fInventories.size(),
                          uncompared == fUncompared.end() ? std::vector<std::size_t>() : uncompared->second, order)
        .Differ();
}

}  // namespace NORVZEL20

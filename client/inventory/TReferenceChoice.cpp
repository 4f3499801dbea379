#include "client/inventory/TReferenceChoice.h"

#include <algorithm>

#include "client/inventory/InventoryLabels.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "client/text/NearestWord.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kFewestForMajority = 3;

[[noreturn]] void RefuseName(const std::string& name, const std::vector<std::string>& labels)
{
    std::vector<std::string> words = labels;
    words.emplace_back(kMajorityLabel);
    const std::string nearest = NearestWord(name, words);
    throw TClientError("no inventory is called " + EscapeForDisplay(name) +
                       (nearest.empty() ? std::string(".") : "; did you mean " + nearest + "?") +
                       " For --reference give one of these labels, or majority: " + SomeOf(labels));
}

void CheckMajority(const std::vector<std::string>& labels)
{
    if (labels.size() < kFewestForMajority) {
        throw TClientError(
            "two inventories have no majority; name three or more, or leave out --reference majority and --outliers");
    }
    if (std::find(labels.begin(), labels.end(), kMajorityLabel) != labels.end()) {
        throw TClientError("an inventory is called majority, the name that reports give to what most inventories hold; "
                           "give it another label: LABEL=SOURCE");
    }
}

}  // namespace

bool TReferenceChoice::WantsMajority() const
{
    return isMajority || name == kMajorityLabel;
}

std::vector<TInventorySources> TReferenceChoice::Apply(std::vector<TInventorySources> inventories) const
{
    const std::vector<std::string> labels = MakeInventoryLabels(inventories);
    if (WantsMajority()) {
        CheckMajority(labels);
    }
    if (name.empty() || name == kMajorityLabel) {
        return inventories;
    }
    auto chosen = std::find(labels.begin(), labels.end(), name) - labels.begin();
    if (static_cast<std::size_t>(chosen) == labels.size()) {
        chosen = std::find_if(inventories.begin(), inventories.end(),
                              [this](const TInventorySources& sources) { return sources.argument == name; }) -
                 inventories.begin();
    }
    if (static_cast<std::size_t>(chosen) == labels.size()) {
        RefuseName(name, labels);
    }
    std::rotate(inventories.begin(), inventories.begin() + chosen, inventories.begin() + chosen + 1);
    return inventories;
}

}  // namespace NORVZEL20

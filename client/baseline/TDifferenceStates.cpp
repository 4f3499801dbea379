// The contents of an instance that only others have are given for the first of them, and for the rest as far as they disagree. So
// those of any inventory are the first one's, with what is said of it in each disagreement.
#include "client/baseline/TDifferenceStates.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>

#include "client/baseline/EntryText.h"
#include "client/baseline/ValueIdentity.h"
#include "client/text/DisplayText.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

// The path without the namespace: the same inventory may be gathered under another one.
std::string WithoutNamespace(const std::string& path, const std::string& className)
{
    const std::size_t at = path.find(":" + className + ".");
    return at == std::string::npos ? path : path.substr(at + 1);
}

// The values of one inventory, which has several if instances share a key; empty if no group has it. The order of the groups
// depends on the other inventories, so it does not count.
std::string ValueOf(std::size_t inventory, const TValueDifference& values)
{
    std::vector<std::string> texts;
    for (const TValueDifference::TGroup& group : values.others) {
        const auto at = std::find(group.inventories.begin(), group.inventories.end(), inventory);
        if (at == group.inventories.end()) {
            continue;
        }
        const std::size_t count = group.CountInstances(static_cast<std::size_t>(at - group.inventories.begin()));
        texts.push_back(ValueIdentity(group.value, values.reference.IsBag() || group.value.IsBag()) +
                        (count > 1 ? " x" + std::to_string(count) : ""));
    }
    std::sort(texts.begin(), texts.end());
    return boost::algorithm::join(texts, kBetweenValues);
}

}  // namespace

TDifferenceStates::TDifferenceStates(const TDifference& difference)
    : fDifference(difference),
      fInstance(FieldText(EscapeForDisplay(difference.path.empty() ? difference.instance
                                                                   : WithoutNamespace(difference.path, difference.className))))
{}

std::string TDifferenceStates::GetProperty() const
{
    return fDifference.kind == TDifference::kChanged ? fDifference.values.front().property : std::string();
}

std::vector<TAcceptedDifference::TValue> TDifferenceStates::ValuesOf(std::size_t inventory) const
{
    switch (fDifference.kind) {
    case TDifference::kOnlyInReference:
        return {};
    case TDifference::kOnlyInOthers:
        return ContentsOf(inventory);
    default:
        break;
    }
    const TValueDifference& change = fDifference.values.front();
    return {{change.property, ValueIdentity(change.reference, change.reference.IsBag()), ValueOf(inventory, change)}};
}

std::vector<TAcceptedDifference::TValue> TDifferenceStates::ContentsOf(std::size_t inventory) const
{
    TNameMap<std::string> contents;
    for (const auto& [property, value] : fDifference.contents) {
        contents[property] = ValueIdentity(value, value.IsBag());
    }
    for (const TValueDifference& disagreement : fDifference.values) {
        contents[disagreement.property] = ValueOf(inventory, disagreement);
    }
    if (const std::size_t sharing = fDifference.CountSharing(inventory); sharing > 0) {
        contents[kInstancesMark] = std::to_string(sharing);
    }
    std::vector<TAcceptedDifference::TValue> values;
    for (auto& [property, text] : contents) {
        if (!text.empty() && text != "NULL") {
            values.push_back({property, std::string(), std::move(text)});
        }
    }
    return values;
}

}  // namespace NORVZEL20

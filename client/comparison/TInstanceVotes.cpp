// The differences of one instance name every inventory that is not like the reference, so those that they do not name are like it.
// Of five inventories in which Size is 1 in the reference, 2 in b, c and d, and which e lacks:
//
//   missing in e; Size: 1 -> 2 (b, c, d)         from the reference
//   who has it: a, b, c, d; Size: 1 (a), 2 (b, c, d)
//   missing in e; Size: 2 -> 1 (a)               from the majority
//
// An instance that the reference lacks comes with the properties in which the others differ from one another, which is as much.
#include "client/comparison/TInstanceVotes.h"

#include <algorithm>
#include <set>

#include "client/comparison/EmbeddedParts.h"
#include "client/comparison/PutContent.h"

namespace NORVZEL20 {

namespace {

using TGroups = std::vector<TValueDifference::TGroup>;

// The majority stands in front of the inventories of the run.
std::vector<std::size_t> BehindMajority(std::vector<std::size_t> inventories)
{
    for (std::size_t& inventory : inventories) {
        ++inventory;
    }
    return inventories;
}

TGroups BehindMajority(TGroups groups)
{
    for (TValueDifference::TGroup& group : groups) {
        group.inventories = BehindMajority(std::move(group.inventories));
    }
    return groups;
}

}  // namespace

TInstanceVotes::TInstanceVotes(const std::vector<TDifference>& differences, std::size_t inventories,
                               const std::vector<std::size_t>& uncompared, TPropertyOrder& order)
    : fDifferences(differences), fOrder(order), fStates(inventories)
{
    FindStates(uncompared);
    for (const TDifference& difference : differences) {
        for (const TValueDifference& values : difference.values) {
            difference.kind == TDifference::kChanged ? AddChange(values) : AddProperty(values.property, values.others);
        }
    }
}

void TInstanceVotes::FindStates(const std::vector<std::size_t>& uncompared)
{
    const bool referenceHas = fDifferences.front().kind != TDifference::kOnlyInOthers;
    std::fill(fStates.begin(), fStates.end(), referenceHas ? kHas : kLacks);
    for (const TDifference& difference : fDifferences) {
        for (const std::size_t inventory : difference.inventories) {
            fStates[inventory] = difference.kind == TDifference::kOnlyInReference ? kLacks : kHas;
        }
    }
    for (const std::size_t inventory : uncompared) {
        fStates[inventory] = kUncompared;
    }
}

// Those that the change does not name have the reference's value, and so do those instances of an inventory that it does not count.
void TInstanceVotes::AddChange(const TValueDifference& change)
{
    TGroups values(1);
    values.front().value = change.reference;
    for (const std::size_t inventory : Which(kHas)) {
        std::size_t like = CountInstances(inventory);
        for (const TValueDifference::TGroup& group : change.others) {
            const auto found = std::lower_bound(group.inventories.begin(), group.inventories.end(), inventory);
            if (found != group.inventories.end() && *found == inventory) {
                like -= group.CountInstances(static_cast<std::size_t>(found - group.inventories.begin()));
            }
        }
        if (like > 0) {
            values.front().Add(inventory, like);
        }
    }
    values.insert(values.end(), change.others.begin(), change.others.end());
    AddProperty(change.property, std::move(values));
}

void TInstanceVotes::AddProperty(const std::string& name, TGroups values)
{
    const std::size_t winner = FindWinner(values);
    fProperties.push_back({name, std::move(values), winner});
}

std::vector<std::size_t> TInstanceVotes::Which(EState state) const
{
    std::vector<std::size_t> which;
    for (std::size_t i = 0; i < fStates.size(); ++i) {
        if (fStates[i] == state) {
            which.push_back(i);
        }
    }
    return which;
}

// How many instances of an inventory were compared.
std::size_t TInstanceVotes::CountInstances(std::size_t inventory) const
{
    return inventory == 0 ? 1 : std::max<std::size_t>(1, fDifferences.front().CountSharing(inventory));
}

// Nulls of different types are one value.
std::size_t TInstanceVotes::FindWinner(const TGroups& values) const
{
    std::vector<std::vector<std::size_t>> voters(values.size());
    const auto null = static_cast<std::size_t>(
        std::find_if(values.begin(), values.end(), [](const auto& group) { return group.value.IsNull(); }) - values.begin());
    for (std::size_t i = 0; i < values.size(); ++i) {
        const TValueDifference::TGroup& group = values[i];
        std::vector<std::size_t>& votes = voters[group.value.IsNull() ? null : i];
        for (std::size_t at = 0; at < group.inventories.size(); ++at) {
            if (group.CountInstances(at) == CountInstances(group.inventories[at])) {
                votes.push_back(group.inventories[at]);
            }
        }
        std::sort(votes.begin(), votes.end());
    }
    const auto isBehind = [](const auto& one, const auto& other) {
        return one.size() != other.size() ? one.size() < other.size() : one > other;
    };
    return static_cast<std::size_t>(std::max_element(voters.begin(), voters.end(), isBehind) - voters.begin());
}

bool TInstanceVotes::HoldsMajority() const
{
    const std::size_t have = Which(kHas).size();
    const std::size_t lack = Which(kLacks).size();
    return have != lack ? have > lack : fStates.front() == kHas;
}

std::vector<TDifference> TInstanceVotes::Differ() const
{
    if (!HoldsMajority()) {
        return {Extra()};
    }
    std::vector<TDifference> all;
    if (!Which(kLacks).empty()) {
        all.push_back(Missing());
    }
    for (const TProperty& property : fProperties) {
        TDifference changed = Changed(property);
        if (!changed.inventories.empty()) {
            all.push_back(std::move(changed));
        }
    }
    return all;
}

TDifference TInstanceVotes::Start(TDifference::EKind kind, std::vector<std::size_t> inventories) const
{
    const TDifference& first = fDifferences.front();
    TDifference difference;
    difference.kind = kind;
    difference.hasKeys = first.hasKeys;
    difference.className = first.className;
    difference.instance = first.instance;
    difference.keys = first.keys;
    difference.inventories = BehindMajority(std::move(inventories));
    if (!first.sharing.empty()) {
        difference.sharing = first.sharing;
        difference.sharing.insert(difference.sharing.begin(), 0);
    }
    return difference;
}

TDifference TInstanceVotes::Missing() const
{
    TDifference missing = Start(TDifference::kOnlyInReference, Which(kLacks));
    missing.path = fDifferences.front().path;
    missing.contents = fDifferences.front().contents;
    for (const TProperty& property : fProperties) {
        PutContent(missing, property.name, property.values[property.winner].value, fOrder);
    }
    return missing;
}

TDifference TInstanceVotes::Extra() const
{
    TDifference extra = Start(TDifference::kOnlyInOthers, Which(kHas));
    extra.contents = fDifferences.front().contents;
    for (const TProperty& property : fProperties) {
        extra.values.push_back({property.name, TCIMValue(), BehindMajority(property.values), {}});
        AddEmbeddedParts(extra.values.back(), false);
    }
    return extra;
}

// Without inventories if nobody differs.
TDifference TInstanceVotes::Changed(const TProperty& property) const
{
    const TValueDifference::TGroup& winner = property.values[property.winner];
    TGroups others;
    std::set<std::size_t> inventories;
    for (const TValueDifference::TGroup& group : property.values) {
        const bool isWinner = &group == &winner || (winner.value.IsNull() && group.value.IsNull());
        if (!isWinner && !group.inventories.empty()) {
            others.push_back(group);
            inventories.insert(group.inventories.begin(), group.inventories.end());
        }
    }
    TDifference changed = Start(TDifference::kChanged, {inventories.begin(), inventories.end()});
    changed.values.push_back({property.name, winner.value, BehindMajority(std::move(others)), {}});
    AddEmbeddedParts(changed.values.front(), true);
    return changed;
}

}  // namespace NORVZEL20

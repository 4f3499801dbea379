// (1) Each difference is judged for each of its inventories: accepted, new, or accepted with another value.
// (2) What is left of the baseline's entries then was not found. It is gone, unless the run could not find it: because no inventory
//     has that label, because the reference has it, or because the class or the property was not compared. Such entries stay.
#include "client/baseline/TBaselineReview.h"

#include <algorithm>
#include <utility>

namespace NORVZEL20 {

namespace {

bool Has(const std::vector<std::string>& labels, const std::string& label)
{
    return std::find(labels.begin(), labels.end(), label) != labels.end();
}

TAcceptedDifference WithLabels(TAcceptedDifference entry, std::vector<std::string> labels)
{
    entry.inventories = std::move(labels);
    return entry;
}

}  // namespace

TBaselineReview::TBaselineReview(IDifferences& all, const TAcceptance& acceptance, bool isAccepting)
    : fAcceptance(acceptance), fIsAccepting(isAccepting), fKept(acceptance.GetBaseline().GetEntries().size()),
      fReplaced(acceptance.GetBaseline().GetEntries().size())
{
    all.ForEach([this](const TDifference& difference) { Add(difference); });
    SortOut();
}

void TBaselineReview::Add(const TDifference& difference)
{
    const TDifferenceStates states(difference);
    std::vector<std::size_t> left;
    std::vector<std::size_t> entries;  // of those in fOutcome.changed that this difference adds
    bool isNew = false;
    for (const std::size_t inventory : difference.inventories) {
        const TAcceptance::TVerdict verdict = fAcceptance.Judge(difference, states, inventory);
        if (verdict.isAccepted) {
            fKept[*verdict.entry].push_back(fAcceptance.LabelOf(inventory));
            continue;
        }
        left.push_back(inventory);
        if (verdict.entry) {
            AddChanged(Present(difference, states, inventory, verdict.present), *verdict.entry, entries);
        } else {
            isNew = true;
        }
        if (fIsAccepting) {
            fUnaccepted.Add(Present(difference, states, inventory, verdict.entry ? verdict.present : states.ValuesOf(inventory)));
        }
    }
    fOutcome.accepted += left.empty() ? 1 : 0;
    fOutcome.appeared += isNew ? 1 : 0;
    const bool isWhole = left.size() == difference.inventories.size();
    fShares.push_back(isWhole ? EUnaccepted::kAll : left.empty() ? EUnaccepted::kNone : EUnaccepted::kSome);
    if (!left.empty()) {
        Count(difference, left);
    }
}

TAcceptedDifference TBaselineReview::Present(const TDifference& difference, const TDifferenceStates& states, std::size_t inventory,
                                             std::vector<TAcceptedDifference::TValue> values) const
{
    return {difference.kind, states.GetInstance(), std::move(values), {fAcceptance.LabelOf(inventory)}};
}

// Inventories with the same values and the same entry stand together.
void TBaselineReview::AddChanged(const TAcceptedDifference& present, std::size_t entry, std::vector<std::size_t>& entries)
{
    fReplaced[entry].push_back(present.inventories.front());
    std::vector<TBaselineOutcome::TChanged>& changed = fOutcome.changed;
    const std::size_t first = changed.size() - entries.size();
    for (std::size_t i = 0; i < entries.size(); ++i) {
        TBaselineOutcome::TChanged& known = changed[first + i];
        if (entries[i] == entry && known.present.values == present.values) {
            known.accepted.inventories.push_back(present.inventories.front());
            known.present.inventories.push_back(present.inventories.front());
            return;
        }
    }
    changed.push_back({WithLabels(fAcceptance.GetBaseline().GetEntries()[entry], present.inventories), present});
    entries.push_back(entry);
}

void TBaselineReview::Count(const TDifference& difference, const std::vector<std::size_t>& left)
{
    const bool areMany = difference.kind == TDifference::kOnlyInOthers;
    fCounter.Add(difference.kind, difference.instance, areMany ? difference.CountInstances(left) : 1);
}

void TBaselineReview::SortOut()
{
    const std::vector<TAcceptedDifference>& entries = fAcceptance.GetBaseline().GetEntries();
    for (std::size_t i = 0; i < entries.size(); ++i) {
        const bool isCompared = fAcceptance.IsCompared(entries[i]);
        std::vector<std::string> gone;
        std::vector<std::string> notCompared;
        bool isOfAbsent = false;
        bool isOfReference = false;
        for (const std::string& label : entries[i].inventories) {
            if (Has(fKept[i], label) || Has(fReplaced[i], label)) {
                continue;
            }
            if (fAcceptance.IsReference(label)) {
                isOfReference = true;
            } else if (!fAcceptance.IsOther(label)) {
                isOfAbsent = true;
                fOutcome.absent.push_back(label);
            } else {
                (isCompared ? gone : notCompared).push_back(label);
            }
            if (gone.empty() || gone.back() != label) {
                fKept[i].push_back(label);
            }
        }
        fOutcome.ofAbsent += isOfAbsent ? 1 : 0;
        fOutcome.ofReference += isOfReference ? 1 : 0;
        if (!gone.empty()) {
            fOutcome.gone.push_back(WithLabels(entries[i], std::move(gone)));
        }
        if (!notCompared.empty()) {
            fOutcome.notCompared.push_back(WithLabels(entries[i], std::move(notCompared)));
        }
    }
    std::sort(fOutcome.absent.begin(), fOutcome.absent.end());
    fOutcome.absent.erase(std::unique(fOutcome.absent.begin(), fOutcome.absent.end()), fOutcome.absent.end());
}

TBaseline TBaselineReview::Accept(const std::string& reason) const
{
    TBaseline result;
    for (const std::string& comment : fAcceptance.GetBaseline().GetComments()) {
        result.AddComment(comment);
    }
    const std::vector<TAcceptedDifference>& entries = fAcceptance.GetBaseline().GetEntries();
    for (std::size_t i = 0; i < entries.size(); ++i) {
        if (!fKept[i].empty()) {
            std::vector<std::string> labels = fKept[i];
            std::sort(labels.begin(), labels.end());
            result.Add(WithLabels(entries[i], std::move(labels)));
        }
    }
    for (TAcceptedDifference entry : fUnaccepted.GetEntries()) {
        entry.reason = reason;
        result.Add(std::move(entry));
    }
    return result;
}

}  // namespace NORVZEL20

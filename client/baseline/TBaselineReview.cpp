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

TBaselineReview::TBaselineReview(IDifferences& all, const TAcceptance& acceptance)
    : fAcceptance(acceptance), fKept(acceptance.GetBaseline().GetEntries().size()),
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
    for (const std::size_t inventory : difference.inventories) {
        const std::string& label = fAcceptance.LabelOf(inventory);
        TAcceptance::TVerdict verdict = fAcceptance.Judge(difference, states, inventory);
        if (verdict.isAccepted) {
            fKept[*verdict.entry].push_back(label);
            continue;
        }
        left.push_back(inventory);
        TAcceptedDifference present{difference.kind,
                                    states.GetInstance(),
                                    verdict.entry ? std::move(verdict.present) : states.ValuesOf(inventory),
                                    {label}};
        if (verdict.entry) {
            fReplaced[*verdict.entry].push_back(label);
            AddChanged(present, *verdict.entry, entries);
        }
        fUnaccepted.Add(std::move(present));
    }
    fOutcome.accepted += left.empty() ? 1 : 0;
    fOutcome.different += entries.empty() ? 0 : 1;
    fOutcome.appeared += !left.empty() && entries.empty() ? 1 : 0;
    if (!left.empty()) {
        Count(difference, left);
    }
}

// Inventories with the same values and the same entry stand together.
void TBaselineReview::AddChanged(const TAcceptedDifference& present, std::size_t entry, std::vector<std::size_t>& entries)
{
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

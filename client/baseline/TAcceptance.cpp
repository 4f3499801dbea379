#include "client/baseline/TAcceptance.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

bool IsLeftOut(const TCoverage::TClass& cls, const std::string& property)
{
    return std::any_of(cls.leftOut.begin(), cls.leftOut.end(),
                       [&](const TCoverage::TLeftOut& leftOut) { return leftOut.property == property; });
}

}  // namespace

TAcceptance::TVerdict TAcceptance::Judge(const TDifference& difference, const TDifferenceStates& states,
                                         std::size_t inventory) const
{
    TVerdict verdict;
    verdict.entry = fBaseline->Find(difference.kind, states.GetInstance(), states.GetProperty(), fReport.labels[inventory]);
    if (!verdict.entry) {
        return verdict;
    }
    const std::vector<TAcceptedDifference::TValue>& accepted = fBaseline->GetEntries()[*verdict.entry].values;
    verdict.present = states.ValuesOf(inventory);
    if (accepted == verdict.present) {
        verdict.isAccepted = true;
        return verdict;
    }
    const TCoverage::TClass* const cls = FindClass(difference.className);
    std::vector<TAcceptedDifference::TValue> compared;
    std::copy_if(accepted.begin(), accepted.end(), std::back_inserter(compared),
                 [cls](const TAcceptedDifference::TValue& value) { return cls == nullptr || !IsLeftOut(*cls, value.property); });
    verdict.isAccepted = compared == verdict.present;
    return verdict;
}

bool TAcceptance::IsCompared(const TAcceptedDifference& entry) const
{
    const TCoverage::TClass* const cls = FindClass(entry.instance.substr(0, entry.instance.find('.')));
    if (cls == nullptr) {
        return true;  // no inventory has an instance of it
    }
    return cls->state == TCoverage::kCompared &&
           (entry.kind != TDifference::kChanged || !IsLeftOut(*cls, entry.values.front().property));
}

bool TAcceptance::IsOther(const std::string& label) const
{
    return std::find(fReport.labels.begin() + 1, fReport.labels.end(), label) != fReport.labels.end();
}

const TCoverage::TClass* TAcceptance::FindClass(const std::string& name) const
{
    const std::vector<TCoverage::TClass>& classes = fReport.coverage.classes;
    const auto found = std::lower_bound(classes.begin(), classes.end(), name,
                                        [](const TCoverage::TClass& cls, const std::string& wanted) { return cls.name < wanted; });
    return found != classes.end() && found->name == name ? &*found : nullptr;
}

}  // namespace NORVZEL20

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

std::optional<std::size_t> TAcceptance::FindEntry(const TDifference& difference, const TDifferenceStates& states,
                                                  std::size_t inventory) const
{
    return fBaseline->Find(difference.kind, states.GetInstance(), states.GetProperty(), fReport.labels[inventory]);
}

TAcceptance::EVerdict TAcceptance::Judge(const TDifference& difference, const TDifferenceStates& states,
                                         std::size_t inventory) const
{
    const std::optional<std::size_t> entry = FindEntry(difference, states, inventory);
    if (!entry) {
        return kNew;
    }
    const std::vector<TAcceptedDifference::TValue>& accepted = fBaseline->GetEntries()[*entry].values;
    const std::vector<TAcceptedDifference::TValue> present = states.ValuesOf(inventory);
    if (accepted == present) {
        return kAccepted;
    }
    const TCoverage::TClass* const cls = FindClass(difference.className);
    std::vector<TAcceptedDifference::TValue> compared;
    std::copy_if(accepted.begin(), accepted.end(), std::back_inserter(compared),
                 [cls](const TAcceptedDifference::TValue& value) { return cls == nullptr || !IsLeftOut(*cls, value.property); });
    return compared == present ? kAccepted : kDifferent;
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

#include "client/baseline/TAcceptance.h"

#include <algorithm>
#include <iterator>

#include "client/baseline/KeysOfInstance.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

bool IsBefore(const TAcceptedDifference::TValue& one, const TAcceptedDifference::TValue& other)
{
    return TNameText::Compare(one.property, other.property) < 0;
}

using TNames = std::set<std::string, TNameText::TLess>;

std::string ClassOf(const TAcceptedDifference& entry)
{
    return entry.instance.substr(0, entry.instance.find('.'));
}

TNames KeyNamesOf(const std::string& instance)
{
    TNames names;
    for (const TKeyText& key : KeysOfInstance(instance)) {
        names.emplace(key.name);
    }
    return names;
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
    if (difference.kind == TDifference::kOnlyInOthers && accepted != verdict.present) {
        const TNames& compared = ComparedOf(difference.className);
        std::copy_if(accepted.begin(), accepted.end(), std::back_inserter(verdict.present),
                     [&compared](const TAcceptedDifference::TValue& value) {
                         return value.property != kInstancesMark && compared.count(value.property) == 0;
                     });
        std::sort(verdict.present.begin(), verdict.present.end(), &IsBefore);
    }
    verdict.isAccepted = accepted == verdict.present;
    return verdict;
}

bool TAcceptance::IsCompared(const TAcceptedDifference& entry) const
{
    const TNames& compared = ComparedOf(ClassOf(entry));
    if (!compared.empty() && !IsKeyed(entry)) {
        return false;
    }
    return entry.kind == TDifference::kChanged ? compared.count(entry.values.front().property) > 0 : !compared.empty();
}

// Whether the entry names the keys by which some inventory of the run knows instances. It does not if the rules excluded other keys
// when it was accepted. The reference must declare the class. An entry of an instance that only the reference has names all keys,
// also those that the rules exclude, as TDifferenceStates::GetInstance says.
bool TAcceptance::IsKeyed(const TAcceptedDifference& entry) const
{
    const std::string className = ClassOf(entry);
    const boost::shared_ptr<TInMemClass> declared = GetReference().ns->FindClass(className);
    const TNames named = KeyNamesOf(entry.instance);
    const bool hasAll = entry.kind == TDifference::kOnlyInReference;
    return std::any_of(fReport.inventories->begin(), fReport.inventories->end(), [&](const TInventory& inventory) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        if (!cls) {
            return false;
        }
        TNames names;
        for (const std::uint32_t slot : cls->GetLayout().GetKeys()) {
            const std::string key = cls->GetLayout().GetDecl(slot).GetName();
            if (hasAll || !fReport.meaning->ExcludesKey(declared->GetName(), key)) {
                names.insert(key);
            }
        }
        return std::equal(names.begin(), names.end(), named.begin(), named.end(), &TNameText::Equal);
    });
}

const TAcceptance::TNames& TAcceptance::ComparedOf(const std::string& className) const
{
    const auto known = fCompared.find(className);
    return known != fCompared.end() ? known->second : fCompared.emplace(className, FindCompared(className)).first->second;
}

// Instances are compared in the classes of the reference. A class without instances anywhere has no coverage, and is compared if
// the rules say so.
TAcceptance::TNames TAcceptance::FindCompared(const std::string& className) const
{
    const boost::shared_ptr<TInMemClass> declared = GetReference().ns->FindClass(className);
    const std::vector<TCoverage::TClass>& classes = fReport.coverage.classes;
    const auto covered = std::find_if(classes.begin(), classes.end(),
                                      [&](const TCoverage::TClass& cls) { return TNameText::Equal(cls.name, className); });
    if (!declared || (covered != classes.end() && covered->state != TCoverage::kCompared)) {
        return TNames();
    }
    const std::vector<std::string> compared = fReport.meaning->PropertiesOf(declared);
    return TNames(compared.begin(), compared.end());
}

bool TAcceptance::IsOther(const std::string& label) const
{
    return std::find(fReport.labels.begin() + 1, fReport.labels.end(), label) != fReport.labels.end();
}

}  // namespace NORVZEL20

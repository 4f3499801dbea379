// Qualifiers of an element and of its ancestors.
//
// Inherited qualifiers are not copied: a set points to its parent, and a search goes up. A qualifier that is added to a superclass
// is therefore visible below at once. The nearest one of a name decides. If its flavor is "restricted" the search ends there
// without a result, even if one farther up would be inherited: the nearer one has replaced it.

#include "embedded/store/TInMemQualifierSet.h"

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

bool IsInherited(const ICIMQualifier& qualifier)
{
    return (qualifier.GetFlavor(TCallContext()) & ICIMQualifierDecl::kFlavorToSubclass) != 0;
}

}  // namespace

bool TInMemQualifierSet::IsNamed(const ICIMQualifier& qualifier, std::string_view name)
{
    return TNameText::Equal(qualifier.GetName(TCallContext()), name);
}

bool TInMemQualifierSet::HoldsTrue(const ICIMQualifier& qualifier)
{
    const TCIMValue& value = qualifier.GetValue(TCallContext());
    return value.GetType() == TCIMValue::TCIMType::kBoolean && !value.IsNull() && value.GetBoolean();
}

void TInMemQualifierSet::Add(boost::shared_ptr<ICIMQualifier> qualifier)
{
    // A replaced qualifier keeps its place in the order.
    for (auto& own : fOwn) {
        if (IsNamed(*own, qualifier->GetName(TCallContext()))) {
            own = std::move(qualifier);
            return;
        }
    }
    fOwn.push_back(std::move(qualifier));
}

boost::shared_ptr<ICIMQualifier> TInMemQualifierSet::FindOwn(std::string_view name) const
{
    for (const auto& own : fOwn) {
        if (IsNamed(*own, name)) {
            return own;
        }
    }
    return nullptr;
}

boost::shared_ptr<ICIMQualifier> TInMemQualifierSet::Find(std::string_view name) const
{
    boost::shared_ptr<ICIMQualifier> found = FindOwn(name);
    for (const TInMemQualifierSet* set = fParent; set && !found; set = set->fParent) {
        found = set->FindOwn(name);
        if (found && !IsInherited(*found)) {
            return nullptr;
        }
    }
    return found;
}

void TInMemQualifierSet::Enumerate(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback) const
{
    for (const TInMemQualifierSet* set = this; set; set = set->fParent) {
        const auto qualifiers = set->fOwn;  // the callback may add some
        for (const auto& qualifier : qualifiers) {
            // Find decides whether an inherited one is visible: a nearer one may replace it, or its flavor may hold it back.
            const bool isSeen = set == this || Find(qualifier->GetName(TCallContext())) == qualifier;
            if (isSeen && !callback(qualifier)) {
                return;
            }
        }
    }
}

std::size_t TInMemQualifierSet::CountAll() const noexcept
{
    std::size_t count = 0;
    for (const TInMemQualifierSet* set = this; set; set = set->fParent) {
        count += set->fOwn.size();
    }
    return count;
}

bool TInMemQualifierSet::IsTrue(std::string_view name) const
{
    const auto qualifier = Find(name);
    return qualifier && HoldsTrue(*qualifier);
}

bool TInMemQualifierSet::IsOwnTrue(std::string_view name) const
{
    const auto own = FindOwn(name);
    return own && HoldsTrue(*own);
}

bool TInMemQualifierSet::IsTrueAnywhere(std::string_view name) const
{
    for (const TInMemQualifierSet* set = this; set; set = set->fParent) {
        if (set->IsOwnTrue(name)) {
            return true;
        }
    }
    return false;
}

}  // namespace NORVZEL20

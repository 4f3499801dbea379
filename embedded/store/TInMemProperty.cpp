#include "embedded/store/TInMemProperty.h"

#include "embedded/store/TInMemBlock.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemInstance.h"

namespace NORVZEL20 {

TInMemProperty::TInMemProperty(std::uint32_t slot, std::uint32_t position, const TCIMValue& value) noexcept
    : fValue(value), fSlot(slot), fPosition(position & 0x3fffffffU), fChanged(0), fRemoved(0)
{}

TInMemInstance& TInMemProperty::GetInstance() const noexcept
{
    return TInMemBlock::GetOwner(*this, fPosition);
}

const TCIMValue& TInMemProperty::GetValue(TCallContext) const
{
    return fValue;
}

void TInMemProperty::SetValue(const TCIMValue& value, TCallContext)
{
    Change(Fit(TCIMValue(value)), false);
}

void TInMemProperty::SetValue(TCIMValue&& value)
{
    Change(Fit(std::move(value)), false);
}

void TInMemProperty::MarkRemoved()
{
    fRemoved = 1;
}

void TInMemProperty::MarkChanged(const TCIMValue& value)
{
    Change(Fit(TCIMValue(value)), true);
}

void TInMemProperty::MarkStandIn(TCIMValue value)
{
    Change(std::move(value), true);
}

TCIMValue TInMemProperty::Fit(TCIMValue&& value) const
{
    const TInMemInstance& instance = GetInstance();
    return instance.GetInMemClass()->GetLayout().GetDecl(fSlot).Fit(std::move(value), &instance);
}

/// Everything that may fail comes first: the caller has checked the new value, and the old one is kept if it will be asked for.
/// Then the value is set.
void TInMemProperty::Change(TCIMValue&& fitting, bool isMarked)
{
    TInMemInstance& instance = GetInstance();
    const TInMemPropertyDecl& decl = instance.GetInMemClass()->GetLayout().GetDecl(fSlot);
    // The index of the extent finds the instance by the key that it was added with.
    if (instance.IsAdded() && decl.IsKey()) {
        instance.KeepKey(fSlot, fValue);
    }
    if (isMarked && !fChanged) {
        instance.KeepEarlier(fSlot, fValue);
        fChanged = 1;
    }
    fValue = std::move(fitting);
}

/// Unlike Change this keeps no earlier value and no key, because the value still means the same.
void TInMemProperty::Rewrite(TCIMValue value)
{
    fValue = Fit(std::move(value));
}

boost::shared_ptr<const ICIMPropertyDecl> TInMemProperty::GetPropertyDecl(TCallContext) const
{
    return GetInstance().GetInMemClass()->GetLayout().GetSharedDecl(fSlot);
}

const TCIMValue* TInMemProperty::GetEarlierValue() const noexcept
{
    return fChanged ? GetInstance().FindEarlier(fSlot) : nullptr;
}

}  // namespace NORVZEL20

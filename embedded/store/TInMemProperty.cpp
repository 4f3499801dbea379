#include "embedded/store/TInMemProperty.h"

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemInstance.h"

namespace NORVZEL20 {

TInMemProperty::TInMemProperty(std::uint32_t slot, std::uint32_t position, const TCIMValue& value) noexcept
    : fValue(value), fSlot(slot), fPosition(position & 0x3fffffffU), fChanged(0), fRemoved(0)
{}

TInMemInstance& TInMemProperty::GetInstance() const noexcept
{
    return TInMemInstance::GetOwner(this - fPosition);
}

const TCIMValue& TInMemProperty::GetValue(TCallContext) const
{
    return fValue;
}

void TInMemProperty::SetValue(const TCIMValue& value, TCallContext)
{
    GetInstance().Change(*this, value);
}

void TInMemProperty::MarkRemoved()
{
    fRemoved = 1;
}

void TInMemProperty::MarkChanged(const TCIMValue& value)
{
    GetInstance().MarkChanged(*this, value);
}

boost::shared_ptr<const ICIMPropertyDecl> TInMemProperty::GetPropertyDecl(TCallContext) const
{
    return GetInstance().GetInMemClass()->GetSharedSlotDecl(fSlot);
}

const TCIMValue* TInMemProperty::GetEarlierValue() const noexcept
{
    return fChanged ? GetInstance().FindEarlier(fSlot) : nullptr;
}

}  // namespace NORVZEL20

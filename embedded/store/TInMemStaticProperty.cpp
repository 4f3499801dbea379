#include "embedded/store/TInMemStaticProperty.h"

#include "embedded/store/TInMemPropertyDecl.h"

namespace NORVZEL20 {

const TCIMValue& TInMemStaticProperty::GetValue(TCallContext) const
{
    return fState.value;
}

void TInMemStaticProperty::SetValue(const TCIMValue& value)
{
    fState.value = TInMemPropertyDecl::WithoutClasses(fDecl.Fit(value));
}

void TInMemStaticProperty::SetValue(const TCIMValue& value, TCallContext)
{
    SetValue(value);
}

void TInMemStaticProperty::MarkRemoved()
{
    fState.isRemoved = true;
}

void TInMemStaticProperty::MarkChanged(const TCIMValue& value)
{
    const TCIMValue before = fState.value;
    SetValue(value);  // may fail, and then nothing is marked
    KeepEarlier(before);
}

void TInMemStaticProperty::MarkStandIn(const TCIMValue& value)
{
    KeepEarlier(fState.value);
    fState.value = value;
}

void TInMemStaticProperty::KeepEarlier(const TCIMValue& earlier)
{
    if (!fState.isChanged) {
        fState.earlier = earlier;
        fState.isChanged = true;
    }
}

boost::shared_ptr<const ICIMPropertyDecl> TInMemStaticProperty::GetPropertyDecl(TCallContext) const
{
    return fDecl.shared_from_this();
}

}  // namespace NORVZEL20

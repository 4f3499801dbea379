#include "embedded/TInMemStaticProperty.h"

#include "embedded/TInMemPropertyDecl.h"

namespace NORVZEL20 {

const TCIMValue& TInMemStaticProperty::GetValue(TCallContext) const
{
    return fValue;
}

void TInMemStaticProperty::SetValue(const TCIMValue& value)
{
    fValue = TInMemPropertyDecl::WithoutClasses(fDecl.Fit(value));
}

void TInMemStaticProperty::SetValue(const TCIMValue& value, TCallContext)
{
    SetValue(value);
}

void TInMemStaticProperty::MarkRemoved() {}

void TInMemStaticProperty::MarkChanged(const TCIMValue& value)
{
    SetValue(value);
}

boost::shared_ptr<const ICIMPropertyDecl> TInMemStaticProperty::GetPropertyDecl(TCallContext) const
{
    return fDecl.shared_from_this();
}

}  // namespace NORVZEL20

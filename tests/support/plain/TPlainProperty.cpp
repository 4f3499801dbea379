#include "tests/support/plain/TPlainProperty.h"

namespace NORVZEL20 {

TPlainProperty::TPlainProperty(boost::shared_ptr<const ICIMPropertyDecl> decl)
    : fDecl(decl), fValue(TCIMValue::Null(decl->GetType(TCallContext())))
{}

const TCIMValue& TPlainProperty::GetValue(TCallContext) const
{
    return fValue;
}

void TPlainProperty::SetValue(const TCIMValue& value, TCallContext)
{
    fValue = value;
}

void TPlainProperty::MarkRemoved()
{
    ++fTimesRemoved;
}

void TPlainProperty::MarkChanged(const TCIMValue& value)
{
    ++fTimesChanged;
    fValue = value;
}

boost::shared_ptr<const ICIMPropertyDecl> TPlainProperty::GetPropertyDecl(TCallContext) const
{
    return fDecl;
}

}  // namespace NORVZEL20

#include "embedded/store/TInMemQualifier.h"

namespace NORVZEL20 {

TInMemQualifier::TInMemQualifier(const std::string& name, const TCIMValue& value, ICIMQualifierDecl::EFlavor flavor)
    : fName(name), fValue(value), fFlavor(flavor)
{}

const std::string& TInMemQualifier::GetName(TCallContext) const
{
    return fName;
}

const TCIMValue& TInMemQualifier::GetValue(TCallContext) const
{
    return fValue;
}

ICIMQualifierDecl::EFlavor TInMemQualifier::GetFlavor(TCallContext) const
{
    return fFlavor;
}

}  // namespace NORVZEL20

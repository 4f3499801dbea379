#include "embedded/store/TInMemQualifierDecl.h"

namespace NORVZEL20 {

TInMemQualifierDecl::TInMemQualifierDecl(const std::string& name, const TCIMValue& value, EScope scope, EFlavor flavor)
    : fName(name), fValue(value), fScope(scope), fFlavor(flavor)
{}

const std::string& TInMemQualifierDecl::GetName(TCallContext) const
{
    return fName;
}

const TCIMValue& TInMemQualifierDecl::GetValue(TCallContext) const
{
    return fValue;
}

ICIMQualifierDecl::EScope TInMemQualifierDecl::GetScope(TCallContext) const
{
    return fScope;
}

ICIMQualifierDecl::EFlavor TInMemQualifierDecl::GetFlavor(TCallContext) const
{
    return fFlavor;
}

}  // namespace NORVZEL20

#include "tests/support/plain/TPlainQualifierDecl.h"

#include <utility>

namespace NORVZEL20 {

TPlainQualifierDecl::TPlainQualifierDecl(std::string name, TCIMValue value, EScope scope, EFlavor flavor)
    : fName(std::move(name)), fValue(std::move(value)), fScope(scope), fFlavor(flavor)
{}

const std::string& TPlainQualifierDecl::GetName(TCallContext) const
{
    return fName;
}

const TCIMValue& TPlainQualifierDecl::GetValue(TCallContext) const
{
    return fValue;
}

ICIMQualifierDecl::EScope TPlainQualifierDecl::GetScope(TCallContext) const
{
    return fScope;
}

ICIMQualifierDecl::EFlavor TPlainQualifierDecl::GetFlavor(TCallContext) const
{
    return fFlavor;
}

}  // namespace NORVZEL20

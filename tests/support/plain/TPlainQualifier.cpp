#include "tests/support/plain/TPlainQualifier.h"

#include <utility>

namespace NORVZEL20 {

TPlainQualifier::TPlainQualifier(std::string name, TCIMValue value, ICIMQualifierDecl::EFlavor flavor)
    : fName(std::move(name)), fValue(std::move(value)), fFlavor(flavor)
{}

const std::string& TPlainQualifier::GetName(TCallContext) const
{
    return fName;
}

const TCIMValue& TPlainQualifier::GetValue(TCallContext) const
{
    return fValue;
}

ICIMQualifierDecl::EFlavor TPlainQualifier::GetFlavor(TCallContext) const
{
    return fFlavor;
}

}  // namespace NORVZEL20

#include "tests/support/watched/TWatchedProperty.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "tests/support/CallText.h"
#include "tests/support/watched/TWatchedPropertyDecl.h"

namespace NORVZEL20 {

TWatchedProperty::TWatchedProperty(boost::shared_ptr<ICIMProperty> property, boost::shared_ptr<TCallWatch> watch,
                                   const std::string& ownerLabel)
    : fProperty(property), fWatch(watch), fOwnerLabel(ownerLabel),
      fLabel(ownerLabel + "." + property->GetPropertyDecl(TCallContext())->GetName(TCallContext()))
{}

const TCIMValue& TWatchedProperty::GetValue(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetValue()" + ContextText(context));
    return fProperty->GetValue(context);
}

void TWatchedProperty::SetValue(const TCIMValue& value, TCallContext context)
{
    fWatch->Called(fLabel + ".SetValue(" + ValueText(value) + ")" + ContextText(context));
    fProperty->SetValue(value, context);
}

void TWatchedProperty::MarkRemoved()
{
    fWatch->Called(fLabel + ".MarkRemoved()");
    fProperty->MarkRemoved();
}

void TWatchedProperty::MarkChanged(const TCIMValue& value)
{
    fWatch->Called(fLabel + ".MarkChanged(" + ValueText(value) + ")");
    fProperty->MarkChanged(value);
}

boost::shared_ptr<const ICIMPropertyDecl> TWatchedProperty::GetPropertyDecl(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetPropertyDecl()" + ContextText(context));
    return boost::make_shared<TWatchedPropertyDecl>(fProperty->GetPropertyDecl(context), fWatch, fOwnerLabel);
}

}  // namespace NORVZEL20

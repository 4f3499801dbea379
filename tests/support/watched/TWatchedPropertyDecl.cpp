#include "tests/support/watched/TWatchedPropertyDecl.h"

#include "host/TZELException.h"
#include "tests/support/CallText.h"

namespace NORVZEL20 {

TWatchedPropertyDecl::TWatchedPropertyDecl(boost::shared_ptr<const ICIMPropertyDecl> decl, boost::shared_ptr<TCallWatch> watch,
                                           const std::string& ownerLabel)
    : fDecl(decl), fWatch(watch), fLabel(ownerLabel + "." + decl->GetName(TCallContext()) + ".Decl")
{}

const std::string& TWatchedPropertyDecl::GetName(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetName()" + ContextText(context));
    return fDecl->GetName(context);
}

TCIMValue::TCIMType TWatchedPropertyDecl::GetType(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetType()" + ContextText(context));
    return fDecl->GetType(context);
}

const TCIMValue& TWatchedPropertyDecl::GetDefaultValue(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetDefaultValue()" + ContextText(context));
    return fDecl->GetDefaultValue(context);
}

void TWatchedPropertyDecl::AddQualifier(boost::shared_ptr<ICIMQualifier>, TCallContext context)
{
    fWatch->Called(fLabel + ".AddQualifier()" + ContextText(context));
    throw TZELException(TZELStatusCode::kNotSupported);
}

boost::shared_ptr<ICIMQualifier> TWatchedPropertyDecl::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                                         const TCIMValue& value, TCallContext context) const
{
    fWatch->Called(fLabel + ".AllocateQualifier()" + ContextText(context));
    return fDecl->AllocateQualifier(decl, value, context);
}

boost::shared_ptr<ICIMQualifier> TWatchedPropertyDecl::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                                         const TCIMValue& value, ICIMQualifierDecl::EFlavor flavor,
                                                                         TCallContext context) const
{
    fWatch->Called(fLabel + ".AllocateQualifier(flavor)" + ContextText(context));
    return fDecl->AllocateQualifier(decl, value, flavor, context);
}

boost::shared_ptr<ICIMQualifier> TWatchedPropertyDecl::GetQualifier(const std::string& name, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetQualifier(" + Quoted(name) + ")" + ContextText(context));
    return fDecl->GetQualifier(name, context);
}

void TWatchedPropertyDecl::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                               TCallContext context) const
{
    fWatch->Called(fLabel + ".EnumerateQualifiers()" + ContextText(context));
    fDecl->EnumerateQualifiers(callback, context);
}

boost::shared_ptr<ICIMQualifier> TWatchedPropertyDecl::GetQualifier(const std::string& name, bool& found,
                                                                    TCallContext context) const
{
    fWatch->Called(fLabel + ".GetQualifier(" + Quoted(name) + ", found)" + ContextText(context));
    return fDecl->GetQualifier(name, found, context);
}

}  // namespace NORVZEL20

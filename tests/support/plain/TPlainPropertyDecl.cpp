#include "tests/support/plain/TPlainPropertyDecl.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "tests/support/plain/TPlainQualifier.h"

namespace NORVZEL20 {

TPlainPropertyDecl::TPlainPropertyDecl(std::string name, TCIMValue defaultValue)
    : fName(std::move(name)), fDefault(std::move(defaultValue))
{}

bool TPlainPropertyDecl::IsKey() const
{
    return fQualifiers.Find("Key", TCallContext()) != nullptr;
}

const std::string& TPlainPropertyDecl::GetName(TCallContext) const
{
    return fName;
}

TCIMValue::TCIMType TPlainPropertyDecl::GetType(TCallContext) const
{
    return fDefault.GetType();
}

const TCIMValue& TPlainPropertyDecl::GetDefaultValue(TCallContext) const
{
    return fDefault;
}

void TPlainPropertyDecl::AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext)
{
    fQualifiers.Add(qualifier);
}

boost::shared_ptr<ICIMQualifier> TPlainPropertyDecl::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                                       const TCIMValue& value, TCallContext context) const
{
    return AllocateQualifier(decl, value, decl->GetFlavor(context), context);
}

boost::shared_ptr<ICIMQualifier> TPlainPropertyDecl::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                                       const TCIMValue& value, ICIMQualifierDecl::EFlavor flavor,
                                                                       TCallContext context) const
{
    return boost::make_shared<TPlainQualifier>(decl->GetName(context), value, flavor);
}

boost::shared_ptr<ICIMQualifier> TPlainPropertyDecl::GetQualifier(const std::string& name, TCallContext context) const
{
    return fQualifiers.Get(name, context);
}

void TPlainPropertyDecl::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                             TCallContext) const
{
    fQualifiers.Enumerate(callback);
}

boost::shared_ptr<ICIMQualifier> TPlainPropertyDecl::GetQualifier(const std::string& name, bool& found, TCallContext context) const
{
    const auto qualifier = fQualifiers.Find(name, context);
    found = qualifier != nullptr;
    return qualifier;
}

}  // namespace NORVZEL20

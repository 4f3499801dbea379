#include "tests/support/plain/TPlainPropertyDecl.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "host/TZELException.h"
#include "tests/support/plain/TPlainQualifier.h"

namespace NORVZEL20 {

TPlainPropertyDecl::TPlainPropertyDecl(std::string name, TCIMValue defaultValue)
    : fName(std::move(name)), fDefault(std::move(defaultValue))
{}

bool TPlainPropertyDecl::IsKey() const
{
    bool found = false;
    GetQualifier("Key", found, TCallContext());
    return found;
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
    fQualifiers.push_back(qualifier);
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
    bool found = false;
    auto qualifier = GetQualifier(name, found, context);
    if (!found) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return qualifier;
}

void TPlainPropertyDecl::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                             TCallContext) const
{
    for (const auto& qualifier : fQualifiers) {
        if (!callback(qualifier)) {
            return;
        }
    }
}

boost::shared_ptr<ICIMQualifier> TPlainPropertyDecl::GetQualifier(const std::string& name, bool& found, TCallContext context) const
{
    for (const auto& qualifier : fQualifiers) {
        if (qualifier->GetName(context) == name) {
            found = true;
            return qualifier;
        }
    }
    found = false;
    return nullptr;
}

}  // namespace NORVZEL20

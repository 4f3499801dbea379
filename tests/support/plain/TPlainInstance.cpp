#include "tests/support/plain/TPlainInstance.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "host/TZELException.h"
#include "tests/support/plain/TPlainClass.h"
#include "tests/support/plain/TPlainNamespace.h"
#include "tests/support/plain/TPlainProperty.h"
#include "tests/support/plain/TPlainPropertyDecl.h"

namespace NORVZEL20 {

TPlainInstance::TPlainInstance(boost::shared_ptr<TPlainClass> cls) : fClass(cls)
{
    for (const auto& decl : cls->GetAllDecls()) {
        fProperties.push_back(boost::make_shared<TPlainProperty>(decl));
    }
}

boost::shared_ptr<TPlainProperty> TPlainInstance::FindProperty(const std::string& name) const
{
    for (const auto& property : fProperties) {
        if (property->GetPropertyDecl(TCallContext())->GetName(TCallContext()) == name) {
            return property;
        }
    }
    return nullptr;
}

void TPlainInstance::Validate(TCallContext) const {}

void TPlainInstance::AddToNamespace(TCallContext context)
{
    for (const auto& key : fClass->GetKeyDecls()) {
        const auto property = FindProperty(key->GetName(context));
        if (property->GetValue(context).IsNull() && key->GetType(context) == TCIMValue::TCIMType::kUint64) {
            property->SetValue(TCIMValue(fClass->NextNumber()), context);
        }
    }
    fReference = MakeReference();
    fAdded = true;
    fClass->AddInstance(shared_from_this());
}

TCIMReference TPlainInstance::GetReference(TCallContext) const
{
    return fAdded ? fReference : MakeReference();
}

TCIMReference TPlainInstance::MakeReference() const
{
    TCIMReference reference;
    if (const auto ns = fClass->GetPlainNamespace()) {
        reference.SetNamespaceName(ns->GetName());
    }
    reference.SetClass(fClass);
    for (const auto& key : fClass->GetKeyDecls()) {
        const std::string& name = key->GetName(TCallContext());
        reference.AddKeyValue(name, FindProperty(name)->GetValue(TCallContext()));
    }
    return reference;
}

boost::shared_ptr<ICIMClass> TPlainInstance::GetClass(TCallContext) const
{
    return fClass;
}

boost::shared_ptr<ICIMProperty> TPlainInstance::GetProperty(const std::string& name, TCallContext) const
{
    const auto property = FindProperty(name);
    if (!property) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return property;
}

void TPlainInstance::EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback, TCallContext) const
{
    for (const auto& property : fProperties) {
        if (!callback(property)) {
            return;
        }
    }
}

}  // namespace NORVZEL20

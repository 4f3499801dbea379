// Everything is stored in the simplest container and searched without an index. Tests have few objects, and a simple host is easy
// to trust.

#include "tests/support/plain/TPlainNamespace.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "host/TZELException.h"
#include "tests/support/plain/TPlainClass.h"
#include "tests/support/plain/TPlainQualifierDecl.h"

namespace NORVZEL20 {

namespace {

[[noreturn]] void Refuse()
{
    throw TZELException(TZELStatusCode::kNotSupported);
}

// The path without the namespace, because callers may leave it out.
std::string LocalPath(TCIMReference path)
{
    path.SetNamespaceName("");
    return path.GetPath();
}

}  // namespace

TPlainNamespace::TPlainNamespace(const std::string& name) : fName(name) {}

boost::shared_ptr<TPlainNamespace> TPlainNamespace::Create(const std::string& name)
{
    boost::shared_ptr<TPlainNamespace> ns(new TPlainNamespace(name));
    ns->fRoot = boost::make_shared<TPlainClass>("<root>", ns, nullptr);
    return ns;
}

TPlainNamespace::~TPlainNamespace()
{
    for (const auto& [name, cls] : fClasses) {
        cls->DropInstances();
    }
}

void TPlainNamespace::Add(boost::shared_ptr<TPlainClass> cls)
{
    fClasses[cls->GetName(TCallContext())] = cls;
}

boost::shared_ptr<INamespaceProvider> TPlainNamespace::GetNamespaceProvider(TCallContext) const
{
    Refuse();
}

void TPlainNamespace::SetUpcallNamespace(boost::shared_ptr<ICIMNamespace>, TCallContext)
{
    Refuse();
}

void TPlainNamespace::AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace>, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMClass> TPlainNamespace::AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                                            TCallContext)
{
    return boost::make_shared<TPlainClass>(name, shared_from_this(), boost::dynamic_pointer_cast<TPlainClass>(superClass));
}

boost::shared_ptr<ICIMClass> TPlainNamespace::GetClass(const std::string& name, TCallContext)
{
    if (name == "<root>") {
        return fRoot;
    }
    const auto found = fClasses.find(name);
    if (found == fClasses.end()) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return found->second;
}

void TPlainNamespace::EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                           TCallContext context)
{
    fRoot->EnumerateSubClasses(callback, false, context);
}

void TPlainNamespace::EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>&, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMQualifierDecl> TPlainNamespace::AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                                            ICIMQualifierDecl::EScope scope,
                                                                            ICIMQualifierDecl::EFlavor flavor, TCallContext)
{
    fQualifierDecls.push_back(boost::make_shared<TPlainQualifierDecl>(name, value, scope, flavor));
    return fQualifierDecls.back();
}

boost::shared_ptr<ICIMQualifierDecl> TPlainNamespace::GetQualifierDecl(const std::string& name, TCallContext context) const
{
    for (const auto& decl : fQualifierDecls) {
        if (decl->GetName(context) == name) {
            return decl;
        }
    }
    throw TZELException(TZELStatusCode::kNotFound);
}

void TPlainNamespace::EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                              TCallContext) const
{
    for (const auto& decl : fQualifierDecls) {
        if (!callback(decl)) {
            return;
        }
    }
}

void TPlainNamespace::Subscribe(boost::shared_ptr<ICIMIndicationFilter>,
                                const boost::function<bool(boost::shared_ptr<ICIMInstance>)>&, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMInstance> TPlainNamespace::GetInstance(const TCIMReference& path, TCallContext context) const
{
    const auto cls = fClasses.find(path.GetClassName());
    boost::shared_ptr<ICIMInstance> result;
    if (cls != fClasses.end()) {
        const auto find = [&](boost::shared_ptr<ICIMInstance> instance) {
            if (LocalPath(instance->GetReference(context)) == LocalPath(path)) {
                result = instance;
            }
            return !result;
        };
        cls->second->EnumerateInstances(find, false, context);
    }
    if (!result) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return result;
}

void TPlainNamespace::DeleteInstance(const TCIMReference& path, TCallContext context)
{
    const auto instance = GetInstance(path, context);
    instance->GetClass(context)->RemoveInstance(instance);
}

void TPlainNamespace::ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context)
{
    const auto instance = GetInstance(path, context);
    for (const auto& [name, value] : properties) {
        instance->GetProperty(name, context)->SetValue(value, context);
    }
}

void TPlainNamespace::ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>&, std::string&, std::string&,
                                   TCallContext)
{
    Refuse();
}

void TPlainNamespace::ClearInstances() {}

ICIMNamespace& TPlainNamespace::operator=(ICIMNamespace&)
{
    return *this;
}

}  // namespace NORVZEL20

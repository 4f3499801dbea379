// Each operation records its line, which may fail the call, and then forwards the call. What the watched namespace returns is
// wrapped in turn, so the calls on it are recorded too. Only TWatchedClass::Unwatched takes a wrapper off: an argument must reach
// the namespace as the object that it knows.

#include "tests/support/watched/TWatchedNamespace.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "provider/TDeltaClass.h"
#include "tests/support/CallText.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedInstance.h"

namespace NORVZEL20 {

TWatchedNamespace::TWatchedNamespace(boost::shared_ptr<ICIMNamespace> ns, boost::shared_ptr<TCallWatch> watch,
                                     const std::string& label)
    : fNamespace(ns), fWatch(watch), fLabel(label)
{}

boost::function<bool(boost::shared_ptr<ICIMClass>)>
TWatchedNamespace::Watching(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback) const
{
    return [this, &callback](boost::shared_ptr<ICIMClass> cls) { return callback(Watched(cls)); };
}

boost::shared_ptr<ICIMClass> TWatchedNamespace::Watched(boost::shared_ptr<ICIMClass> cls) const
{
    if (!cls || boost::dynamic_pointer_cast<TDeltaClass>(cls)) {
        return cls;
    }
    return boost::make_shared<TWatchedClass>(cls, fWatch, fLabel);
}

boost::shared_ptr<ICIMInstance> TWatchedNamespace::Watched(boost::shared_ptr<ICIMInstance> instance) const
{
    TCIMReference path = instance->GetReference(TCallContext());
    path.SetNamespaceName("");
    return boost::make_shared<TWatchedInstance>(instance, fWatch, fLabel + ":" + path.GetPath(), fLabel);
}

boost::shared_ptr<INamespaceProvider> TWatchedNamespace::GetNamespaceProvider(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetNamespaceProvider()" + ContextText(context));
    return fNamespace->GetNamespaceProvider(context);
}

void TWatchedNamespace::SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context)
{
    fWatch->Called(fLabel + ".SetUpcallNamespace()" + ContextText(context));
    fNamespace->SetUpcallNamespace(ns, context);
}

void TWatchedNamespace::AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context)
{
    fWatch->Called(fLabel + ".AddUnderlyingNamespace()" + ContextText(context));
    fNamespace->AddUnderlyingNamespace(ns, context);
}

boost::shared_ptr<ICIMClass> TWatchedNamespace::AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                                              TCallContext context)
{
    fWatch->Called(fLabel + ".AllocateClass(" + Quoted(name) + ")" + ContextText(context));
    return Watched(fNamespace->AllocateClass(name, TWatchedClass::Unwatched(superClass), context));
}

boost::shared_ptr<ICIMClass> TWatchedNamespace::GetClass(const std::string& name, TCallContext context)
{
    fWatch->Called(fLabel + ".GetClass(" + Quoted(name) + ")" + ContextText(context));
    return Watched(fNamespace->GetClass(name, context));
}

void TWatchedNamespace::EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                             TCallContext context)
{
    fWatch->Called(fLabel + ".EnumerateRootClasses()" + ContextText(context));
    fNamespace->EnumerateRootClasses(Watching(callback), context);
}

void TWatchedNamespace::EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback,
                                           TCallContext context)
{
    fWatch->Called(fLabel + ".EnumerateProviders()" + ContextText(context));
    fNamespace->EnumerateProviders(callback, context);
}

boost::shared_ptr<ICIMQualifierDecl> TWatchedNamespace::AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                                              ICIMQualifierDecl::EScope scope,
                                                                              ICIMQualifierDecl::EFlavor flavor,
                                                                              TCallContext context)
{
    fWatch->Called(fLabel + ".AllocateQualifierDecl(" + Quoted(name) + ", " + ValueText(value) + ")" + ContextText(context));
    return fNamespace->AllocateQualifierDecl(name, value, scope, flavor, context);
}

boost::shared_ptr<ICIMQualifierDecl> TWatchedNamespace::GetQualifierDecl(const std::string& name, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetQualifierDecl(" + Quoted(name) + ")" + ContextText(context));
    return fNamespace->GetQualifierDecl(name, context);
}

void TWatchedNamespace::EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                                TCallContext context) const
{
    fWatch->Called(fLabel + ".EnumerateQualifierDecls()" + ContextText(context));
    fNamespace->EnumerateQualifierDecls(callback, context);
}

void TWatchedNamespace::Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                                  const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context)
{
    fWatch->Called(fLabel + ".Subscribe()" + ContextText(context));
    fNamespace->Subscribe(filter, callback, context);
}

boost::shared_ptr<ICIMInstance> TWatchedNamespace::GetInstance(const TCIMReference& path, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetInstance(" + path.GetPath() + ")" + ContextText(context));
    return Watched(fNamespace->GetInstance(path, context));
}

void TWatchedNamespace::DeleteInstance(const TCIMReference& path, TCallContext context)
{
    fWatch->Called(fLabel + ".DeleteInstance(" + path.GetPath() + ")" + ContextText(context));
    fNamespace->DeleteInstance(path, context);
}

void TWatchedNamespace::ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context)
{
    fWatch->Called(fLabel + ".ModifyInstance(" + path.GetPath() + ", " + ContextText(properties).substr(1) + ")" +
                   ContextText(context));
    fNamespace->ModifyInstance(path, properties, context);
}

void TWatchedNamespace::ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                                     std::string& query, TCallContext context)
{
    fWatch->Called(fLabel + ".ExecuteQuery(" + Quoted(language) + ", " + Quoted(query) + ")" + ContextText(context));
    fNamespace->ExecuteQuery(callback, language, query, context);
}

void TWatchedNamespace::ClearInstances()
{
    fWatch->Called(fLabel + ".ClearInstances()");
    fNamespace->ClearInstances();
}

ICIMNamespace& TWatchedNamespace::operator=(ICIMNamespace& other)
{
    fWatch->Called(fLabel + ".operator=()");
    return fNamespace->operator=(other);
}

}  // namespace NORVZEL20

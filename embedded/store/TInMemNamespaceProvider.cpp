#include "embedded/store/TInMemNamespaceProvider.h"

#include "embedded/store/TInMemNamespace.h"
#include "host/TNamespaceProviderManager.h"

namespace NORVZEL20 {

namespace {

// Registered when the library is loaded, and so before any library that needs it.
[[maybe_unused]] const TZELStatusCode kRegistered =
    TNamespaceProviderManager::GetInstance()->RegisterProvider(TInMemNamespaceProvider::GetInstance());

}  // namespace

boost::shared_ptr<TInMemNamespaceProvider> TInMemNamespaceProvider::GetInstance()
{
    // Never destroyed: namespaces may be used until the very end of the process.
    static const auto& fgInstance = *new boost::shared_ptr<TInMemNamespaceProvider>(new TInMemNamespaceProvider);
    return fgInstance;
}

const std::string& TInMemNamespaceProvider::GetName(TCallContext) const
{
    static const std::string& fgName = *new std::string("inmem");
    return fgName;
}

boost::shared_ptr<ICIMNamespace> TInMemNamespaceProvider::AllocateNamespace(TCallContext, bool, std::string name) const
{
    return TInMemNamespace::Create(name);
}

int TInMemNamespaceProvider::GetType(TCallContext) const
{
    return 0;
}

bool TInMemNamespaceProvider::IsIndicationsSupported(TCallContext) const
{
    return false;
}

}  // namespace NORVZEL20

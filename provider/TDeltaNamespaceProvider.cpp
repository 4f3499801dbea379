#include "provider/TDeltaNamespaceProvider.h"

#include "host/TRootObject.h"
#include "provider/DeltaNames.h"
#include "provider/TDeltaNamespace.h"

// The plug-in needs no entry point: the initialisation of kLoaded, below, registers the provider while the library is loaded. The
// provider and its name are initialised on first use, so a static object of a host may ask for them at any time.

namespace NORVZEL20 {

namespace {

void InmemInit()
{
    TDeltaNamespaceProvider::Initialize();
}

[[maybe_unused]] const bool kLoaded = (InmemInit(), true);

}  // namespace

boost::shared_ptr<TDeltaNamespaceProvider> TDeltaNamespaceProvider::GetInstance()
{
    static const boost::shared_ptr<TDeltaNamespaceProvider> fgInstance(new TDeltaNamespaceProvider);
    return fgInstance;
}

TZELStatusCode TDeltaNamespaceProvider::Initialize()
{
    const boost::shared_ptr<INamespaceProvider> provider = GetInstance();
    TRootObject::GetNamespaceProviderManager()->RegisterProvider(provider);
    return TZELStatusCode::kSuccess;
}

const std::string& TDeltaNamespaceProvider::GetName(TCallContext) const
{
    static const std::string nspName(kDeltaProviderName);
    return nspName;
}

boost::shared_ptr<ICIMNamespace> TDeltaNamespaceProvider::AllocateNamespace(TCallContext, bool, std::string) const
{
    const boost::shared_ptr<TDeltaNamespace> ns(new TDeltaNamespace);
    ns->Initialize();
    return ns;
}

int TDeltaNamespaceProvider::GetType(TCallContext) const
{
    return 1;
}

bool TDeltaNamespaceProvider::IsIndicationsSupported(TCallContext) const
{
    return false;
}

}  // namespace NORVZEL20

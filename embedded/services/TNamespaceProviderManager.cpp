// The registry of namespace providers: a list in order of registration, behind a mutex. Providers register from static
// initialisers of their libraries, in an order that nobody controls, so the registry is made on first use. It has few entries;
// look-up goes through all of them.

#include "host/TNamespaceProviderManager.h"

#include <algorithm>

namespace NORVZEL20 {

boost::shared_ptr<TNamespaceProviderManager> TNamespaceProviderManager::GetInstance()
{
    // Never destroyed: the libraries of the providers end in an unknown order.
    static const auto& fgInstance = *new boost::shared_ptr<TNamespaceProviderManager>(new TNamespaceProviderManager);
    return fgInstance;
}

TZELStatusCode TNamespaceProviderManager::RegisterProvider(boost::shared_ptr<INamespaceProvider> provider)
{
    if (!provider) {
        return TZELStatusCode::kInvalidParameter;
    }
    const std::string& name = provider->GetName(TCallContext());
    const std::lock_guard<std::mutex> lock(fMutex);
    const bool isThere =
        std::any_of(fProviders.begin(), fProviders.end(),
                    [&name](const boost::shared_ptr<INamespaceProvider>& other) { return other->GetName(TCallContext()) == name; });
    if (isThere) {
        return TZELStatusCode::kAlreadyExists;
    }
    fProviders.push_back(std::move(provider));
    return TZELStatusCode::kSuccess;
}

boost::shared_ptr<INamespaceProvider> TNamespaceProviderManager::FindProvider(const std::string& name)
{
    const std::lock_guard<std::mutex> lock(fMutex);
    for (const auto& provider : fProviders) {
        if (provider->GetName(TCallContext()) == name) {
            return provider;
        }
    }
    return nullptr;
}

std::vector<std::string> TNamespaceProviderManager::GetProviderNames() const
{
    const std::lock_guard<std::mutex> lock(fMutex);
    std::vector<std::string> names;
    for (const auto& provider : fProviders) {
        names.push_back(provider->GetName(TCallContext()));
    }
    return names;
}

}  // namespace NORVZEL20

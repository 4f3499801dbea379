// The registry of namespace providers: a list in order of registration, behind a mutex. Providers register from static
// initialisers of their libraries, in an order that nobody controls, so the registry is made on first use. It has few entries;
// look-up goes through all of them.
//
// An entry keeps the provider's name as it was at the registration. A provider is code of another library: it may call the registry
// itself, which must not happen under the mutex, and its name may be destroyed at the end of the process before the registry is.

#include "host/TNamespaceProviderManager.h"

#include <algorithm>
#include <utility>

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
    std::string name = provider->GetName(TCallContext());
    const std::lock_guard<std::mutex> lock(fMutex);
    const bool isThere = std::any_of(fEntries.begin(), fEntries.end(), [&name](const TEntry& entry) { return entry.name == name; });
    if (isThere) {
        return TZELStatusCode::kAlreadyExists;
    }
    fEntries.push_back({std::move(name), std::move(provider)});
    return TZELStatusCode::kSuccess;
}

boost::shared_ptr<INamespaceProvider> TNamespaceProviderManager::FindProvider(const std::string& name)
{
    const std::lock_guard<std::mutex> lock(fMutex);
    for (const TEntry& entry : fEntries) {
        if (entry.name == name) {
            return entry.provider;
        }
    }
    return nullptr;
}

std::vector<std::string> TNamespaceProviderManager::GetProviderNames() const
{
    const std::lock_guard<std::mutex> lock(fMutex);
    std::vector<std::string> names;
    for (const TEntry& entry : fEntries) {
        names.push_back(entry.name);
    }
    return names;
}

}  // namespace NORVZEL20

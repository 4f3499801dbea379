// Loads a library of namespace providers. The library registers its providers from its static initialisers, which run inside of
// dlopen: the names that the registry has afterwards and did not have before are its providers.

#include "embedded/services/TProviderLibrary.h"

#include <dlfcn.h>

#include "embedded/services/TCoreLog.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

TProviderLibrary::TProviderLibrary(std::string path, std::vector<std::string> providerNames)
    : fPath(std::move(path)), fProviderNames(std::move(providerNames))
{}

TProviderLibrary TProviderLibrary::Load(const std::string& path)
{
    const auto manager = TNamespaceProviderManager::GetInstance();
    const std::size_t before = manager->GetProviderNames().size();
    // RTLD_NODELETE, because objects of the library may live until the process ends. An empty path would open the program itself.
    if (path.empty() || dlopen(path.c_str(), RTLD_NOW | RTLD_GLOBAL | RTLD_NODELETE) == nullptr) {
        const char* const reason = path.empty() ? "the path is empty" : dlerror();
        TCoreLog::Get()->Log(0,
                             "Cannot load provider library \"" + path + "\": " + (reason != nullptr ? reason : "unknown reason"));
        throw TZELException(TZELStatusCode::kFileError);
    }
    std::vector<std::string> names = manager->GetProviderNames();
    names.erase(names.begin(), names.begin() + static_cast<std::vector<std::string>::difference_type>(before));
    return TProviderLibrary(path, std::move(names));
}

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

#include "host/Export.h"

namespace NORVZEL20 {

/// A library of namespace providers, loaded at run time. It registers its providers while it is being loaded. It stays loaded until
/// the process ends, because its objects may be in use anywhere.
///
/// Threads: one Load at a time.
class CIMDELTA_EXPORT TProviderLibrary {
  public:
    /// Loads the shared library at `path`. A library that is loaded already registers nothing new.
    /// Errors: TZELException with kFileError (11) if it cannot be loaded; the core log then gets the reason at level 0.
    static TProviderLibrary Load(const std::string& path);

    const std::string& GetPath() const noexcept { return fPath; }
    /// The names of the providers that it registered, in order of registration.
    const std::vector<std::string>& GetProviderNames() const noexcept { return fProviderNames; }

  private:
    TProviderLibrary(std::string path, std::vector<std::string> providerNames);

    std::string fPath;
    std::vector<std::string> fProviderNames;
};

}  // namespace NORVZEL20

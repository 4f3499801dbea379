#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// A library of namespace providers, loaded at run time. It registers its providers while it is loaded, and it stays until the
/// process ends: what it made may be in use anywhere.
///
/// Threads: one Load at a time.
class TProviderLibrary {
  public:
    /// Loads the shared library at `path`. A library that is loaded already is found again and registers nothing new.
    /// Errors: TZELException with status 11 where it cannot be loaded; the core log then has the reason at level 0.
    static TProviderLibrary Load(const std::string& path);

    const std::string& GetPath() const noexcept { return fPath; }
    /// The names of the providers that registered while it was loaded, in that order.
    const std::vector<std::string>& GetProviderNames() const noexcept { return fProviderNames; }

  private:
    TProviderLibrary(std::string path, std::vector<std::string> providerNames);

    std::string fPath;
    std::vector<std::string> fProviderNames;
};

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <utility>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// A provider that has a name and makes no namespaces.
class TNamedProvider : public INamespaceProvider {
  public:
    explicit TNamedProvider(std::string name) : fName(std::move(name)) {}

    const std::string& GetName(TCallContext) const override { return fName; }
    boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext, bool, std::string) const override { return nullptr; }
    int GetType(TCallContext) const override { return 0; }
    bool IsIndicationsSupported(TCallContext) const override { return false; }

  private:
    std::string fName;
};

}  // namespace NORVZEL20

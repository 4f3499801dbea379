#pragma once

#include <string>
#include <utility>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// A provider that has a name and makes no namespaces. It counts how often it is asked for the name.
class TNamedProvider : public INamespaceProvider {
  public:
    explicit TNamedProvider(std::string name) : fName(std::move(name)) {}

    const std::string& GetName(TCallContext) const override
    {
        ++fQuestionCount;
        return fName;
    }
    boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext, bool, std::string) const override { return nullptr; }
    int GetType(TCallContext) const override { return 0; }
    bool IsIndicationsSupported(TCallContext) const override { return false; }

    void Rename(const std::string& name) { fName = name; }
    int GetQuestionCount() const { return fQuestionCount; }

  private:
    std::string fName;
    mutable int fQuestionCount = 0;
};

}  // namespace NORVZEL20

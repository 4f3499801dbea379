#pragma once

#include <string>

#include "host/ICIMInstance.h"
#include "tests/support/watched/TCallWatch.h"

namespace NORVZEL20 {

/// An instance that records its calls. Its class gives it its label; see TWatchedClass.
class TWatchedInstance : public ICIMInstance {
  public:
    TWatchedInstance(boost::shared_ptr<ICIMInstance> instance, boost::shared_ptr<TCallWatch> watch, const std::string& label,
                     const std::string& namespaceLabel);

    boost::shared_ptr<ICIMInstance> GetWatched() const { return fInstance; }

    void Validate(TCallContext context) const override;
    void AddToNamespace(TCallContext context) override;
    TCIMReference GetReference(TCallContext context) const override;
    boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const override;
    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const override;
    void EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                             TCallContext context) const override;

  private:
    boost::shared_ptr<ICIMInstance> fInstance;
    boost::shared_ptr<TCallWatch> fWatch;
    std::string fLabel;
    std::string fNamespaceLabel;
};

}  // namespace NORVZEL20

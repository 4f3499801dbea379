#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <vector>

#include "host/ICIMInstance.h"

namespace NORVZEL20 {

class TPlainClass;
class TPlainProperty;

/// An instance of the plain host.
///
/// Adding it checks nothing, so equal keys and null keys are accepted. A null key of type uint64 gets the next number of the class,
/// which keeps records with equal contents apart. The path does not change after that.
class TPlainInstance : public ICIMInstance, public boost::enable_shared_from_this<TPlainInstance> {
  public:
    explicit TPlainInstance(boost::shared_ptr<TPlainClass> cls);

    boost::shared_ptr<TPlainProperty> FindProperty(const std::string& name) const;

    void Validate(TCallContext context) const override;
    void AddToNamespace(TCallContext context) override;
    TCIMReference GetReference(TCallContext context) const override;
    boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const override;
    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const override;
    void EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                             TCallContext context) const override;

  private:
    TCIMReference MakeReference() const;

    boost::shared_ptr<TPlainClass> fClass;
    std::vector<boost::shared_ptr<TPlainProperty>> fProperties;
    TCIMReference fReference;
    bool fAdded = false;
};

}  // namespace NORVZEL20

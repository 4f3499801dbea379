#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/ICIMElement.h"
#include "host/ICIMProperty.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

class ICIMClass;

/// An instance of a class. The order of the operations is part of the contract.
///
/// Made by ICIMClass::AllocateInstance with every property null, filled through GetProperty, and visible in its namespace from
/// AddToNamespace on.
class ICIMInstance : public ICIMElement {
  public:
    /// Makes the instance part of its class's namespace.
    /// Errors: status 12 where one with the same keys is there, 14 where a key has no value, 18 where the namespace is gone.
    virtual void AddToNamespace(TCallContext context) = 0;

    /// The object path: namespace, class and keys. A key changed after the instance was added shows as it was added.
    virtual TCIMReference GetReference(TCallContext context) const = 0;

    virtual boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const = 0;

    /// The property of that name; letter case does not count. Errors: status 15 where the class declares none.
    virtual boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const = 0;

    /// All properties, in the order of their declarations, until the callback returns false.
    virtual void EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                     TCallContext context) const = 0;
};

}  // namespace NORVZEL20

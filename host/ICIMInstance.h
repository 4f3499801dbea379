#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
#include "host/ICIMElement.h"
#include "host/ICIMProperty.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

class ICIMClass;

/// An instance of a class. The order of the operations is part of the contract.
///
/// ICIMClass::AllocateInstance makes it with every property null. Its properties are set through GetProperty, and AddToNamespace
/// makes it visible.
class CIMDELTA_EXPORT ICIMInstance : public ICIMElement {
  public:
    /// Makes the instance part of its class's namespace.
    /// Errors: kAlreadyExists (12) if the namespace has an instance with the same keys, kKeyMissing (14) if a key has no value,
    /// kNamespaceGone (18).
    virtual void AddToNamespace(TCallContext context) = 0;

    /// The object path: namespace, class and keys. The path has the keys that the instance was added with, even if a key was
    /// changed later.
    virtual TCIMReference GetReference(TCallContext context) const = 0;

    virtual boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const = 0;

    /// The property of that name, in any letter case. Errors: kNotFound (15) if the class does not declare it.
    virtual boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const = 0;

    /// All properties, in the order of their declarations, until the callback returns false.
    virtual void EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                     TCallContext context) const = 0;
};

}  // namespace NORVZEL20

#pragma once

#include "embedded/value/TEmbeddedObject.h"
#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"

namespace NORVZEL20 {

/// Classes and properties of a namespace as free-standing objects, for writing and comparing.
class TStoredObjects {
  public:
    TStoredObjects() = delete;

    /// What the class itself declares or overrides, with its own qualifiers. For a class of another host, which the interfaces show
    /// only in part: everything that it has, inherited elements included, and methods without parameters.
    static TEmbeddedObject FromClass(const ICIMClass& cls);

    /// The class without the elements and qualifiers that are marked as propagated from a superclass.
    static TEmbeddedObject WithoutInherited(const TEmbeddedObject& cls);

    /// One property of an instance, without qualifiers.
    static TEmbeddedObject::TProperty FromProperty(const ICIMProperty& property);
};

}  // namespace NORVZEL20

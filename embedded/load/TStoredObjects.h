#pragma once

#include "embedded/value/TEmbeddedObject.h"
#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMMethodDecl.h"

namespace NORVZEL20 {

class TInMemClass;

/// Classes and properties of a namespace as free-standing objects, for writing and comparing.
class CIMDELTA_INTERNAL_EXPORT TStoredObjects {
  public:
    TStoredObjects() = delete;

    /// What the class itself declares or overrides, with its own qualifiers. For a class of another host, which the interfaces show
    /// only in part: everything that it has, inherited elements included, and methods without parameters.
    static TEmbeddedObject FromClass(const ICIMClass& cls);

    /// A class as a document describes it, without what it repeats from `super`, its superclass (null for none): what FromClass
    /// returns when it has been declared.
    static TEmbeddedObject WithoutInherited(const TEmbeddedObject& cls, const TInMemClass* super);

    /// One method, with its own qualifiers.
    static TEmbeddedObject::TMethod FromMethod(const ICIMMethodDecl& decl);

    /// One property of an instance, without qualifiers.
    static TEmbeddedObject::TProperty FromProperty(const ICIMProperty& property);
};

}  // namespace NORVZEL20

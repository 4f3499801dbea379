#pragma once

#include "embedded/value/TEmbeddedObject.h"
#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"

namespace NORVZEL20 {

/// Classes and instances of a namespace as free-standing objects, for writing and comparing.
class TCimXmlObjects {
  public:
    TCimXmlObjects() = delete;

    /// What the class itself declares or overrides, with its own qualifiers. A class of another host than this one shows all that
    /// it has, inherited elements included, because the interfaces do not tell them apart; parameters it does not show.
    static TEmbeddedObject FromClass(const ICIMClass& cls);

    /// The class without the elements and qualifiers that are marked as propagated from a superclass.
    static TEmbeddedObject WithoutInherited(const TEmbeddedObject& cls);

    /// One property of an instance, without qualifiers.
    static TEmbeddedObject::TProperty FromProperty(const ICIMProperty& property);
};

}  // namespace NORVZEL20

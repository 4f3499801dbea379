#pragma once

#include <string>

#include "host/Export.h"
#include "host/ICIMNamedElement.h"

namespace NORVZEL20 {

/// The declaration of a method in a class.
class CIMDELTA_EXPORT ICIMMethodDecl : public ICIMNamedElement {
  public:
    /// The name as declared. Valid while the declaration lives.
    virtual const std::string& GetName(TCallContext context) const = 0;
    /// The type of the result; kNone if the method returns nothing.
    virtual TCIMValue::TCIMType GetType(TCallContext context) const = 0;
};

}  // namespace NORVZEL20

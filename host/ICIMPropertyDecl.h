#pragma once

#include <string>

#include "host/Export.h"
#include "host/ICIMNamedElement.h"

namespace NORVZEL20 {

/// The declaration of a property in a class.
class CIMDELTA_EXPORT ICIMPropertyDecl : public ICIMNamedElement {
  public:
    /// The name as declared. Valid while the declaration lives.
    virtual const std::string& GetName(TCallContext context) const = 0;
    virtual TCIMValue::TCIMType GetType(TCallContext context) const = 0;
    /// The declared default, or a typed null. Valid while the declaration lives. New instances do not start with it.
    virtual const TCIMValue& GetDefaultValue(TCallContext context) const = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "host/Export.h"
#include "host/ICIMQualifierDecl.h"

namespace NORVZEL20 {

/// A qualifier: a named value that describes a class, property or method (DSP0004, 5.6 "Qualifiers").
class CIMDELTA_EXPORT ICIMQualifier {
  public:
    virtual ~ICIMQualifier() = default;

    /// The name as declared. Valid while the qualifier lives.
    virtual const std::string& GetName(TCallContext context) const = 0;
    /// Valid while the qualifier lives.
    virtual const TCIMValue& GetValue(TCallContext context) const = 0;
    virtual ICIMQualifierDecl::EFlavor GetFlavor(TCallContext context) const = 0;
};

}  // namespace NORVZEL20

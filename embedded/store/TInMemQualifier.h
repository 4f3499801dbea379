#pragma once

#include <string>

#include "host/Export.h"
#include "host/ICIMQualifier.h"

namespace NORVZEL20 {

/// A qualifier on an element of the in-memory namespace. Immutable.
class CIMDELTA_INTERNAL_EXPORT TInMemQualifier : public ICIMQualifier {
  public:
    TInMemQualifier(const std::string& name, const TCIMValue& value, ICIMQualifierDecl::EFlavor flavor);

    const std::string& GetName(TCallContext context) const override;
    const TCIMValue& GetValue(TCallContext context) const override;
    ICIMQualifierDecl::EFlavor GetFlavor(TCallContext context) const override;

  private:
    std::string fName;
    TCIMValue fValue;
    ICIMQualifierDecl::EFlavor fFlavor;
};

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "host/Export.h"
#include "host/ICIMQualifierDecl.h"

namespace NORVZEL20 {

/// A qualifier's declaration as the in-memory namespace keeps it. Immutable.
class CIMDELTA_EXPORT TInMemQualifierDecl : public ICIMQualifierDecl {
  public:
    /// The value gives type and default; it may be a typed null.
    TInMemQualifierDecl(const std::string& name, const TCIMValue& value, EScope scope, EFlavor flavor);

    const std::string& GetName(TCallContext context) const override;
    const TCIMValue& GetValue(TCallContext context) const override;
    EScope GetScope(TCallContext context) const override;
    EFlavor GetFlavor(TCallContext context) const override;

    const std::string& GetName() const noexcept { return fName; }
    const TCIMValue& GetValue() const noexcept { return fValue; }
    EScope GetScope() const noexcept { return fScope; }
    EFlavor GetFlavor() const noexcept { return fFlavor; }

  private:
    std::string fName;
    TCIMValue fValue;
    EScope fScope;
    EFlavor fFlavor;
};

}  // namespace NORVZEL20

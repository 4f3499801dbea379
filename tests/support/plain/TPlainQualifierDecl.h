#pragma once

#include <string>

#include "host/ICIMQualifierDecl.h"

namespace NORVZEL20 {

/// A qualifier declaration of the plain host.
class TPlainQualifierDecl : public ICIMQualifierDecl {
  public:
    TPlainQualifierDecl(std::string name, TCIMValue value, EScope scope, EFlavor flavor);

    const std::string& GetName(TCallContext context) const override;
    const TCIMValue& GetValue(TCallContext context) const override;
    EScope GetScope(TCallContext context) const override;
    EFlavor GetFlavor(TCallContext context) const override;

  private:
    std::string fName;
    TCIMValue fValue;
    EScope fScope;
    EFlavor fFlavor;
};

}  // namespace NORVZEL20

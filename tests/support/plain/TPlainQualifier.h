#pragma once

#include <string>

#include "host/ICIMQualifier.h"

namespace NORVZEL20 {

/// A qualifier of the plain host: a name, a value and a flavor.
class TPlainQualifier : public ICIMQualifier {
  public:
    TPlainQualifier(std::string name, TCIMValue value, ICIMQualifierDecl::EFlavor flavor);

    const std::string& GetName(TCallContext context) const override;
    const TCIMValue& GetValue(TCallContext context) const override;
    ICIMQualifierDecl::EFlavor GetFlavor(TCallContext context) const override;

  private:
    std::string fName;
    TCIMValue fValue;
    ICIMQualifierDecl::EFlavor fFlavor;
};

}  // namespace NORVZEL20

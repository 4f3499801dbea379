#pragma once

#include <string>

#include "host/ICIMProperty.h"
#include "tests/support/watched/TCallWatch.h"

namespace NORVZEL20 {

/// A property that records its calls.
class TWatchedProperty : public ICIMProperty {
  public:
    TWatchedProperty(boost::shared_ptr<ICIMProperty> property, boost::shared_ptr<TCallWatch> watch, const std::string& ownerLabel);

    const TCIMValue& GetValue(TCallContext context) const override;
    void SetValue(const TCIMValue& value, TCallContext context) override;
    void MarkRemoved() override;
    void MarkChanged(const TCIMValue& value) override;
    boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const override;

  private:
    boost::shared_ptr<ICIMProperty> fProperty;
    boost::shared_ptr<TCallWatch> fWatch;
    std::string fOwnerLabel;
    std::string fLabel;
};

}  // namespace NORVZEL20

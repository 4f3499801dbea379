#pragma once

#include "host/ICIMProperty.h"

namespace NORVZEL20 {

/// A property of the plain host. It accepts any value and counts how often it was marked.
class TPlainProperty : public ICIMProperty {
  public:
    explicit TPlainProperty(boost::shared_ptr<const ICIMPropertyDecl> decl);

    unsigned int GetTimesRemoved() const { return fTimesRemoved; }
    unsigned int GetTimesChanged() const { return fTimesChanged; }

    const TCIMValue& GetValue(TCallContext context) const override;
    void SetValue(const TCIMValue& value, TCallContext context) override;
    void MarkRemoved() override;
    void MarkChanged(const TCIMValue& value) override;
    boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const override;

  private:
    boost::shared_ptr<const ICIMPropertyDecl> fDecl;
    TCIMValue fValue;
    unsigned int fTimesRemoved = 0;
    unsigned int fTimesChanged = 0;
};

}  // namespace NORVZEL20

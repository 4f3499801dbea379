#pragma once

#include "host/ICIMProperty.h"

namespace NORVZEL20 {

class TInMemPropertyDecl;

/// The value of a static property, one for the class, its subclasses and all their instances. Lives in its declaration.
///
/// It has no marks: MarkChanged sets the value, MarkRemoved does nothing.
class TInMemStaticProperty : public ICIMProperty {
  public:
    explicit TInMemStaticProperty(TInMemPropertyDecl& decl) noexcept : fDecl(decl) {}
    TInMemStaticProperty(const TInMemStaticProperty&) = delete;
    TInMemStaticProperty& operator=(const TInMemStaticProperty&) = delete;

    const TCIMValue& GetValue(TCallContext context) const override;
    void SetValue(const TCIMValue& value, TCallContext context) override;
    void MarkRemoved() override;
    void MarkChanged(const TCIMValue& value) override;
    boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const override;

    const TCIMValue& GetValue() const noexcept { return fValue; }
    void SetValue(const TCIMValue& value);

  private:
    friend class TInMemPropertyDecl;

    TInMemPropertyDecl& fDecl;
    TCIMValue fValue;
};

}  // namespace NORVZEL20

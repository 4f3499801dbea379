#pragma once

#include <string>

#include "host/ICIMPropertyDecl.h"
#include "tests/support/plain/TPlainQualifiers.h"

namespace NORVZEL20 {

/// A property declaration of the plain host. A qualifier "Key" makes it a key.
class TPlainPropertyDecl : public ICIMPropertyDecl {
  public:
    TPlainPropertyDecl(std::string name, TCIMValue defaultValue);

    bool IsKey() const;

    const std::string& GetName(TCallContext context) const override;
    TCIMValue::TCIMType GetType(TCallContext context) const override;
    const TCIMValue& GetDefaultValue(TCallContext context) const override;

    void AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext context) override;
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       ICIMQualifierDecl::EFlavor flavor, TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, TCallContext context) const override;
    void EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                             TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, bool& found, TCallContext context) const override;

  private:
    std::string fName;
    TCIMValue fDefault;
    TPlainQualifiers fQualifiers;
};

}  // namespace NORVZEL20

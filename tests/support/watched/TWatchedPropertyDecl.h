#pragma once

#include <string>

#include "host/ICIMPropertyDecl.h"
#include "tests/support/watched/TCallWatch.h"

namespace NORVZEL20 {

/// A property declaration that records its calls.
class TWatchedPropertyDecl : public ICIMPropertyDecl {
  public:
    TWatchedPropertyDecl(boost::shared_ptr<const ICIMPropertyDecl> decl, boost::shared_ptr<TCallWatch> watch,
                         const std::string& ownerLabel);

    boost::shared_ptr<const ICIMPropertyDecl> GetWatched() const { return fDecl; }

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
    boost::shared_ptr<const ICIMPropertyDecl> fDecl;
    boost::shared_ptr<TCallWatch> fWatch;
    std::string fLabel;
};

}  // namespace NORVZEL20

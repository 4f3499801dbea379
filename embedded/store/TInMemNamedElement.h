#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "embedded/store/TInMemQualifierSet.h"
#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/ICIMMethodDecl.h"
#include "host/ICIMNamedElement.h"
#include "host/ICIMPropertyDecl.h"

namespace NORVZEL20 {

/// The qualifier operations of ICIMNamedElement, for classes, properties, methods and parameters alike.
template <class TInterface>
class CIMDELTA_EXPORT TInMemNamedElement : public TInterface {
  public:
    /// Errors: kInvalidParameter (5) for null.
    void AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext context) override;
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       ICIMQualifierDecl::EFlavor flavor, TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, bool& found, TCallContext context) const override;
    void EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                             TCallContext context) const override;

    const TInMemQualifierSet& GetQualifiers() const noexcept { return fQualifiers; }
    /// As AddQualifier.
    void AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier);

  protected:
    /// Adds a qualifier, which is not null. If it fails, nothing has changed. Elements that derive something from their qualifiers
    /// override it.
    virtual void PutQualifier(boost::shared_ptr<ICIMQualifier> qualifier) { fQualifiers.Add(std::move(qualifier)); }
    void InheritQualifiers(const TInMemQualifierSet* parent) noexcept { fQualifiers.SetParent(parent); }

  private:
    TInMemQualifierSet fQualifiers;
};

extern template class TInMemNamedElement<ICIMNamedElement>;
extern template class TInMemNamedElement<ICIMClass>;
extern template class TInMemNamedElement<ICIMPropertyDecl>;
extern template class TInMemNamedElement<ICIMMethodDecl>;

}  // namespace NORVZEL20

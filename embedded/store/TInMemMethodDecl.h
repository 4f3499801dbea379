#pragma once

#include <string>
#include <vector>

#include "embedded/store/TInMemNamedElement.h"
#include "embedded/store/TInMemParameter.h"
#include "host/Export.h"
#include "host/ICIMMethodDecl.h"

namespace NORVZEL20 {

/// A method's declaration: name, type of the result and parameters. Nothing implements it here.
class CIMDELTA_EXPORT TInMemMethodDecl : public TInMemNamedElement<ICIMMethodDecl> {
  public:
    TInMemMethodDecl(const std::string& name, TCIMValue::TCIMType type);

    const std::string& GetName(TCallContext context) const override;
    TCIMValue::TCIMType GetType(TCallContext context) const override;

    const std::string& GetName() const noexcept { return fName; }
    TCIMValue::TCIMType GetType() const noexcept { return fType; }

    /// The class that a reference result points to; empty if none was named.
    const std::string& GetReferenceClass() const noexcept { return fReferenceClass; }
    void SetReferenceClass(const std::string& name) { fReferenceClass = name; }
    void AddParameter(boost::shared_ptr<TInMemParameter> parameter) { fParameters.push_back(std::move(parameter)); }
    /// In order of declaration.
    const std::vector<boost::shared_ptr<TInMemParameter>>& GetParameters() const noexcept { return fParameters; }

    /// Names the declaration that this one overrides, from which it inherits qualifiers; null for none.
    void SetOverridden(boost::shared_ptr<const TInMemMethodDecl> overridden);
    const boost::shared_ptr<const TInMemMethodDecl>& GetOverridden() const noexcept { return fOverridden; }

  private:
    std::string fName;
    std::string fReferenceClass;
    TCIMValue::TCIMType fType;
    std::vector<boost::shared_ptr<TInMemParameter>> fParameters;
    boost::shared_ptr<const TInMemMethodDecl> fOverridden;
};

}  // namespace NORVZEL20

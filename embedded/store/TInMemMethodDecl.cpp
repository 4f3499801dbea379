#include "embedded/store/TInMemMethodDecl.h"

namespace NORVZEL20 {

TInMemMethodDecl::TInMemMethodDecl(const std::string& name, TCIMValue::TCIMType type) : fName(name), fType(type) {}

const std::string& TInMemMethodDecl::GetName(TCallContext) const
{
    return fName;
}

TCIMValue::TCIMType TInMemMethodDecl::GetType(TCallContext) const
{
    return fType;
}

void TInMemMethodDecl::SetOverridden(boost::shared_ptr<const TInMemMethodDecl> overridden)
{
    fOverridden = std::move(overridden);
    InheritQualifiers(fOverridden ? &fOverridden->GetQualifiers() : nullptr);
}

}  // namespace NORVZEL20

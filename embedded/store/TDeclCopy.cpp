#include "embedded/store/TDeclCopy.h"

#include <boost/smart_ptr/make_shared.hpp>

namespace NORVZEL20 {

namespace {

void CopyQualifiers(const ICIMNamedElement& source, ICIMNamedElement& copy)
{
    source.EnumerateQualifiers(
        [&copy](boost::shared_ptr<ICIMQualifier> qualifier) {
            copy.AddQualifier(TDeclCopy::CopyQualifier(*qualifier), TCallContext());
            return true;
        },
        TCallContext());
}

/// Parameters are not part of the host's interfaces, so their source is always of this host.
boost::shared_ptr<TInMemParameter> CopyParameter(const TInMemParameter& source)
{
    auto copy = boost::make_shared<TInMemParameter>(source.GetName(), source.GetType());
    copy->SetReferenceClass(source.GetReferenceClass());
    copy->SetArraySize(source.GetArraySize());
    CopyQualifiers(source, *copy);
    return copy;
}

}  // namespace

boost::shared_ptr<TInMemQualifier> TDeclCopy::CopyQualifier(const ICIMQualifier& source)
{
    const TCallContext none;
    return boost::make_shared<TInMemQualifier>(source.GetName(none), source.GetValue(none), source.GetFlavor(none));
}

void TDeclCopy::CopyOwnQualifiers(const TInMemQualifierSet& source, ICIMNamedElement& copy)
{
    for (const auto& qualifier : source.GetOwn()) {
        copy.AddQualifier(CopyQualifier(*qualifier), TCallContext());
    }
}

boost::shared_ptr<TInMemPropertyDecl> TDeclCopy::CopyProperty(const ICIMPropertyDecl& source)
{
    const TCallContext none;
    // The default value of a reference may name the class that it points to; the constructor takes it from there.
    auto copy = boost::make_shared<TInMemPropertyDecl>(source.GetName(none), source.GetDefaultValue(none));
    if (const auto* inMem = dynamic_cast<const TInMemPropertyDecl*>(&source)) {
        copy->SetReferenceClass(inMem->GetReferenceClass());
        copy->SetArraySize(inMem->GetArraySize());
    }
    CopyQualifiers(source, *copy);
    return copy;
}

boost::shared_ptr<TInMemMethodDecl> TDeclCopy::CopyMethod(const ICIMMethodDecl& source)
{
    const TCallContext none;
    auto copy = boost::make_shared<TInMemMethodDecl>(source.GetName(none), source.GetType(none));
    if (const auto* inMem = dynamic_cast<const TInMemMethodDecl*>(&source)) {
        copy->SetReferenceClass(inMem->GetReferenceClass());
        for (const auto& parameter : inMem->GetParameters()) {
            copy->AddParameter(CopyParameter(*parameter));
        }
    }
    CopyQualifiers(source, *copy);
    return copy;
}

}  // namespace NORVZEL20

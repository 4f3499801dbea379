#include "embedded/store/TInMemNamedElement.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/store/TInMemQualifier.h"
#include "embedded/store/TStoreRefusal.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

template <class TInterface>
void TInMemNamedElement<TInterface>::AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier)
{
    if (!qualifier) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    PutQualifier(std::move(qualifier));
}

template <class TInterface>
void TInMemNamedElement<TInterface>::AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext)
{
    AddQualifier(std::move(qualifier));
}

template <class TInterface>
boost::shared_ptr<ICIMQualifier> TInMemNamedElement<TInterface>::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                                                   const TCIMValue& value,
                                                                                   TCallContext context) const
{
    return AllocateQualifier(decl, value, decl->GetFlavor(context), context);
}

template <class TInterface>
boost::shared_ptr<ICIMQualifier>
TInMemNamedElement<TInterface>::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                  ICIMQualifierDecl::EFlavor flavor, TCallContext context) const
{
    // A null takes the declared type; any other value must have it.
    const TCIMValue::TCIMType type = decl->GetValue(context).GetType();
    if (!value.IsNull() && value.GetType() != type) {
        throw TStoreRefusal(TZELStatusCode::kTypeMismatch, [&] {
            return "qualifier " + decl->GetName(context) + TStoreRefusal::OfOtherType(type, value.GetType());
        });
    }
    return boost::make_shared<TInMemQualifier>(decl->GetName(context), value.IsNull() ? TCIMValue::Null(type) : value, flavor);
}

template <class TInterface>
boost::shared_ptr<ICIMQualifier> TInMemNamedElement<TInterface>::GetQualifier(const std::string& name, TCallContext) const
{
    auto qualifier = fQualifiers.Find(name);
    if (!qualifier) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return qualifier;
}

template <class TInterface>
boost::shared_ptr<ICIMQualifier> TInMemNamedElement<TInterface>::GetQualifier(const std::string& name, bool& found,
                                                                              TCallContext) const
{
    auto qualifier = fQualifiers.Find(name);
    found = qualifier != nullptr;
    return qualifier;
}

template <class TInterface>
void TInMemNamedElement<TInterface>::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                                         TCallContext) const
{
    fQualifiers.Enumerate(callback);
}

template class TInMemNamedElement<ICIMNamedElement>;
template class TInMemNamedElement<ICIMClass>;
template class TInMemNamedElement<ICIMPropertyDecl>;
template class TInMemNamedElement<ICIMMethodDecl>;

}  // namespace NORVZEL20

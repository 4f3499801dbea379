#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/ICIMQualifier.h"
#include "host/ICIMQualifierDecl.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// An element that bears qualifiers. The order of the operations is part of the contract.
class ICIMNamedElement {
  public:
    virtual ~ICIMNamedElement() = default;

    /// Puts `qualifier` on the element; one of the same name is replaced.
    virtual void AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext context) = 0;

    /// Makes a qualifier of `decl` with `value` and the declared flavor, and puts it on nothing.
    /// Errors: status 13 where the value does not have the declared type.
    virtual boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                               const TCIMValue& value, TCallContext context) const = 0;
    /// The same with a flavor of its own.
    virtual boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                               const TCIMValue& value, ICIMQualifierDecl::EFlavor flavor,
                                                               TCallContext context) const = 0;

    /// The qualifier of that name, the element's own or inherited. Errors: status 15 where there is none.
    virtual boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, TCallContext context) const = 0;

    /// The element's own qualifiers in the order they were added, then the inherited ones, until the callback returns false.
    virtual void EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                     TCallContext context) const = 0;

    /// As GetQualifier, but tells in `found` whether there is one, and returns null where there is none.
    virtual boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, bool& found, TCallContext context) const = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
#include "host/ICIMQualifier.h"
#include "host/ICIMQualifierDecl.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// An element that has qualifiers. The order of the operations is part of the contract.
class CIMDELTA_EXPORT ICIMNamedElement {
  public:
    virtual ~ICIMNamedElement() = default;

    /// Adds `qualifier` to the element; it replaces one of the same name.
    virtual void AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext context) = 0;

    /// A new qualifier of `decl` with `value` and the declared flavor. No element has it until AddQualifier.
    /// Errors: kTypeMismatch (13) if the value does not have the declared type.
    virtual boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                               const TCIMValue& value, TCallContext context) const = 0;
    /// The same with `flavor` instead of the declared flavor.
    virtual boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                               const TCIMValue& value, ICIMQualifierDecl::EFlavor flavor,
                                                               TCallContext context) const = 0;

    /// The qualifier of that name, own or inherited. Errors: kNotFound (15).
    virtual boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, TCallContext context) const = 0;

    /// The element's own qualifiers in the order in which they were added, then the inherited ones, until the callback returns
    /// false.
    virtual void EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                     TCallContext context) const = 0;

    /// The same without an error: sets `found`, and returns null if the element has no such qualifier.
    virtual boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, bool& found, TCallContext context) const = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/ICIMPropertyDecl.h"
#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// One property value of an instance, or a static property of a class. The order of the operations is part of the contract.
///
/// A handle keeps the instance alive that it was got from. Reading allocates nothing.
class ICIMProperty {
  public:
    virtual ~ICIMProperty() = default;

    /// Valid while the property lives; changes with it.
    virtual const TCIMValue& GetValue(TCallContext context) const = 0;

    /// Gives the property a value; null of any type clears it. Errors: status 13 where the value does not fit the declared
    /// type; the property is then as it was.
    virtual void SetValue(const TCIMValue& value, TCallContext context) = 0;

    /// Marks the value as gone from the other side of a comparison. The value stays.
    virtual void MarkRemoved() = 0;

    /// Gives the property the other side's value and remembers what it held before the first such change.
    /// Errors: as SetValue.
    virtual void MarkChanged(const TCIMValue& value) = 0;

    virtual boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const = 0;
};

}  // namespace NORVZEL20

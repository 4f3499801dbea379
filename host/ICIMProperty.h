#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/Export.h"
#include "host/ICIMPropertyDecl.h"
#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// One property value of an instance, or a static property of a class. The order of the operations is part of the contract.
///
/// A handle keeps its instance alive. Reading allocates nothing.
class CIMDELTA_EXPORT ICIMProperty {
  public:
    virtual ~ICIMProperty() = default;

    /// The current value: the reference shows later changes too. Valid while the property lives.
    virtual const TCIMValue& GetValue(TCallContext context) const = 0;

    /// Sets the value; a null of any type clears it.
    /// Errors: kTypeMismatch (13) if the value does not fit the declared type; the property then keeps its value.
    virtual void SetValue(const TCIMValue& value, TCallContext context) = 0;

    /// Records that the other side of a comparison lacks this value. The value stays.
    virtual void MarkRemoved() = 0;

    /// Sets the value to that of the other side of a comparison and remembers the value before the first such change.
    /// Errors: as SetValue.
    virtual void MarkChanged(const TCIMValue& value) = 0;

    virtual boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext context) const = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/ICIMNamespace.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Gives a key value read from a path's text the type that the class declares for the key.
class TKeyConversion {
  public:
    TKeyConversion() = delete;

    /// Values of the type come back as they are. Else: an integer becomes any integer type that holds it, or a real; a real a
    /// real32 that holds it; text a datetime, a reference (`ns` gives its class) or a char16 where it reads as one. Errors: status
    /// 13 for everything else, nulls included.
    static TCIMValue Convert(const TCIMValue& value, TCIMValue::TCIMType type, const boost::shared_ptr<ICIMNamespace>& ns);
};

}  // namespace NORVZEL20

#pragma once

#include <boost/function.hpp>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The value with what `read` makes of each text in it: the value itself, or the elements of an array. Nulls and values of other
/// types stay as they are. Errors: those of `read`; std::bad_alloc.
TCIMValue ReadEachText(const TCIMValue& value, const boost::function<TCIMValue(const TCIMValue&)>& read);

}  // namespace NORVZEL20

#pragma once

#include <boost/function.hpp>

#include "host/Export.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Calls `change` for each reference in `value`: the value itself, the elements of an array, and the properties of embedded
/// objects, which may nest. References in the keys of a reference are left to `change`.
///
/// `change` returns whether it changed the reference that it is given. Returns whether any was changed. A value in which nothing
/// changes is not copied. Errors: those of `change`, which leave `value` as it was; std::bad_alloc.
CIMDELTA_INTERNAL_EXPORT bool ChangeReferences(TCIMValue& value, const boost::function<bool(TCIMValue&)>& change);

}  // namespace NORVZEL20

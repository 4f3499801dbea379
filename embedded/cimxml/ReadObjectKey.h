#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

class TInMemNamespace;

/// The embedded object that the text of a key describes; the text itself if it describes none. References in the object keep the
/// namespaces that they name. `depth` counts the embedded objects around the key; too many of them, and the key stays text.
///
/// It is TInMemNamespace::TReadObject. A key that is wrong does not end a load, because the path around it may be right as text.
/// Errors: std::bad_alloc. Cost: makes an XML parser.
TCIMValue ReadObjectKey(const TCIMValue& text, const boost::shared_ptr<const TInMemNamespace>& ns, std::size_t depth);

}  // namespace NORVZEL20

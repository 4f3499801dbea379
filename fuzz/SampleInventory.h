#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// A small CIM-XML document with every kind of element: all types, arrays, keys, inheritance, an association, embedded objects.
const std::string& GetSampleDocument();

/// A new namespace that holds the sample document.
boost::shared_ptr<TInMemNamespace> LoadSample();

/// Writes the namespace as one CIM-XML document. It names a namespace to which no reference points; without a name, the references
/// that point elsewhere would decide which namespace the document is in.
std::string WriteDocument(ICIMNamespace& ns);

}  // namespace NORVZEL20

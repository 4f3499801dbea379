#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "embedded/load/EBadValues.h"

namespace NORVZEL20 {

class TInMemNamespace;

/// How a load settles what its documents leave open. A plain value; the defaults are those of a load without options.
struct TLoadOptions {
    /// The namespace of documents that name none, unless their references name it; see TOwnPlaceSearch. Empty: root/cimv2.
    std::string namespaceName;

    /// What becomes of values that do not fit their types.
    EBadValues badValues = EBadValues::kRefuse;

    /// The classes that the documents need and do not declare are declared as in this namespace; null for none. It is only read, so
    /// concurrent loads may share it. Instances of these classes take more memory while they wait for the end of the documents.
    boost::shared_ptr<const TInMemNamespace> schema;

    /// Whether classes that nothing declares are declared as their instances suggest; see TClassInference.
    bool infersClasses = false;

    /// Whether only declarations are loaded: instances are read, and left out.
    bool takesDeclarationsOnly = false;
};

}  // namespace NORVZEL20

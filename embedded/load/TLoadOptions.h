#pragma once

#include <string>

namespace NORVZEL20 {

/// How a load settles what its documents leave open. A plain value; the defaults are those of a load without options.
struct TLoadOptions {
    /// The namespace of documents that name none, unless their references name it; see TOwnPlaceSearch. Empty: root/cimv2.
    std::string namespaceName;
};

}  // namespace NORVZEL20

#pragma once

#include <cstdint>
#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A property of the instance being filled. A plain value, valid while the class lives.
struct TCimXmlTarget {
    const std::string* name;  ///< as declared
    std::uint32_t slot;
    TCIMValue::TCIMType type;
    bool isEmbedded;  ///< whether text may be an embedded object, as the declaration says
    bool isStatic;    ///< whether all instances share the value
};

}  // namespace NORVZEL20

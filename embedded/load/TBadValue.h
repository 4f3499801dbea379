#pragma once

#include <cstddef>
#include <string>

#include "embedded/load/TLoadPlace.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A property's value that does not fit its type, while it is read.
struct TBadValue {
    std::size_t property = 0;  ///< in a draft: the position among the object's properties
    TCIMValue value;           ///< as text: a string, or an array of strings and nulls
    std::string text;          ///< what does not fit; of an array, its first such element
    std::string type;          ///< the type that it does not fit, as messages call it
    TLoadPlace place;
};

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "embedded/load/TLoadPlace.h"

namespace NORVZEL20 {

/// A part of a document that is read again later.
struct TMofPart {
    std::string text;
    TLoadPlace place;  ///< of its first character
};

}  // namespace NORVZEL20

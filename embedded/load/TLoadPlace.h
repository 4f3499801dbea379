#pragma once

#include <cstddef>

#include "embedded/load/TTextPlace.h"

namespace NORVZEL20 {

/// A place in one of the documents of a load.
struct TLoadPlace {
    std::size_t document = 0;  ///< its number, from 0, in the order in which they were begun
    TTextPlace place;
};

}  // namespace NORVZEL20

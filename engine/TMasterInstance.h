#pragma once

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// An instance of the reference, and whether the namespace at hand has one of the same key.
class TCIMDiffEngine::TMasterInstance {
  public:
    boost::shared_ptr<ICIMInstance> instance;
    int found = 0;  ///< 1 where it has; reset after each namespace
};

}  // namespace NORVZEL20

#pragma once

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// An instance of the reference, and whether the namespace compared now has an instance of the same key.
class TCIMDiffEngine::TMasterInstance {
  public:
    boost::shared_ptr<ICIMInstance> instance;
    int found = 0;  ///< 1 if it has; reset to 0 after each namespace
};

}  // namespace NORVZEL20

#pragma once

#include <stdexcept>

#include "host/Export.h"

namespace NORVZEL20 {

/// A check of the shared-pointer library failed, such as dereferencing a null pointer ("px != 0"). This is a programming error; it
/// ends the call but not the process. what() has the expression, function, file and line. The core log gets the same at level 0.
class CIMDELTA_EXPORT TAssertionFailure : public std::logic_error {
  public:
    using std::logic_error::logic_error;
};

}  // namespace NORVZEL20

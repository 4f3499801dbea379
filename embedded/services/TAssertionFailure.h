#pragma once

#include <stdexcept>

namespace NORVZEL20 {

/// A check of the shared-pointer library failed, such as the dereferencing of a null pointer ("px != 0"): a programming error that
/// ends the call and not the process. what() tells expression, function, file and line; the core log has got the same at level 0.
class TAssertionFailure : public std::logic_error {
  public:
    using std::logic_error::logic_error;
};

}  // namespace NORVZEL20

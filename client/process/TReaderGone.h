#pragma once

#include <exception>

namespace NORVZEL20 {

/// The reader of the result has closed the pipe, or standard output was closed from the start. The command ends with
/// kExitTrouble (2) and without a message, because nobody waits for one.
class TReaderGone : public std::exception {
  public:
    const char* what() const noexcept override { return "the reader of the result has gone"; }
};

}  // namespace NORVZEL20

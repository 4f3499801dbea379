#pragma once

#include <stdexcept>
#include <string>

namespace NORVZEL20 {

/// Trouble that ends a command with exit status 2; what() is what the person reads, in whole.
class TClientError : public std::runtime_error {
  public:
    explicit TClientError(const std::string& text) : std::runtime_error(text) {}
};

}  // namespace NORVZEL20

#pragma once

#include <stdexcept>
#include <string>
#include <system_error>

namespace NORVZEL20 {

/// Trouble that ends a command with kExitTrouble (2); what() is the whole message for the person, without "cimdelta: ".
class TClientError : public std::runtime_error {
  public:
    explicit TClientError(const std::string& text) : std::runtime_error(text) {}

    /// A call of the operating system failed: `text`, the system's words for the reason, `advice`.
    TClientError(const std::string& text, const std::error_code& reason, const std::string& advice = std::string())
        : std::runtime_error(text + ": " + reason.message() + advice)
    {}
};

}  // namespace NORVZEL20

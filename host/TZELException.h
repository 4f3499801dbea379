#pragma once

#include <exception>

#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// The one failure of the object model: a status, thrown by value.
class TZELException : public std::exception {
  public:
    explicit TZELException(TZELStatusCode status) noexcept;
    TZELException(const TZELException& other) noexcept = default;
    TZELException& operator=(const TZELException& other) noexcept = default;
    ~TZELException() noexcept override;

    /// The characters of the status's text.
    const char* what() const noexcept override;

    TZELStatusCode GetStatusCode() const noexcept { return fStatusCode; }

  private:
    TZELStatusCode fStatusCode;
};

}  // namespace NORVZEL20

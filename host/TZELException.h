#pragma once

#include <exception>

#include "host/Export.h"
#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// The exception that every operation of the object model throws: a status. Throw it by value.
class CIMDELTA_EXPORT TZELException : public std::exception {
  public:
    explicit TZELException(TZELStatusCode status) noexcept;
    TZELException(const TZELException& other) noexcept = default;
    TZELException& operator=(const TZELException& other) noexcept = default;
    ~TZELException() noexcept override;

    /// The text of the status. Allocates nothing.
    const char* what() const noexcept override;

    TZELStatusCode GetStatusCode() const noexcept { return fStatusCode; }

  private:
    TZELStatusCode fStatusCode;
};

}  // namespace NORVZEL20

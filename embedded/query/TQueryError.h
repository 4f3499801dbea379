#pragma once

#include <cstddef>
#include <string>

#include "host/TZELException.h"

namespace NORVZEL20 {

/// A query that cannot be answered: status 16 for a bad text, 17 for an unknown language, 15 for an unknown class or property.
class TQueryError : public TZELException {
  public:
    /// `position` counts bytes from 0.
    TQueryError(TZELStatusCode status, const std::string& message, std::size_t position);

    /// The whole text, such as "query, column 15: expected FROM, found 'FORM'".
    const char* what() const noexcept override { return fText.c_str(); }
    /// Without the position.
    const std::string& GetMessage() const noexcept { return fMessage; }
    /// The byte of the query, counted from 0, where the trouble begins.
    std::size_t GetPosition() const noexcept { return fPosition; }

  private:
    std::string fMessage;
    std::string fText;
    std::size_t fPosition;
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>

#include "host/Export.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

/// A query that cannot be answered: kInvalidQuery (16) for its text, kQueryLanguageUnknown (17) for its language, kNotFound (15)
/// for an unknown class or property.
class CIMDELTA_EXPORT TQueryError : public TZELException {
  public:
    /// `position` is a byte offset, counted from 0.
    TQueryError(TZELStatusCode status, const std::string& message, std::size_t position);

    /// The message with the position, such as "query, column 15: expected FROM, found 'FORM'".
    const char* what() const noexcept override { return fText.c_str(); }
    /// The message without the position.
    const std::string& GetMessage() const noexcept { return fMessage; }
    /// The byte offset of the error in the query, counted from 0.
    std::size_t GetPosition() const noexcept { return fPosition; }

  private:
    std::string fMessage;
    std::string fText;
    std::size_t fPosition;
};

}  // namespace NORVZEL20

#pragma once

#include <string>

#include "host/Export.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

/// A class would go beyond TSchemaLimits. Status: kNotSupported (31).
class CIMDELTA_EXPORT TSchemaLimitError : public TZELException {
  public:
    /// `text` says which limit, for people.
    explicit TSchemaLimitError(const std::string& text);
    ~TSchemaLimitError() noexcept override;

    const char* what() const noexcept override { return fText.c_str(); }

  private:
    std::string fText;
};

}  // namespace NORVZEL20

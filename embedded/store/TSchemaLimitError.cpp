#include "embedded/store/TSchemaLimitError.h"

namespace NORVZEL20 {

TSchemaLimitError::TSchemaLimitError(const std::string& text) : TZELException(TZELStatusCode::kNotSupported), fText(text) {}

TSchemaLimitError::~TSchemaLimitError() noexcept = default;

}  // namespace NORVZEL20

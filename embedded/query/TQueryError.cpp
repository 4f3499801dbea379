#include "embedded/query/TQueryError.h"

namespace NORVZEL20 {

TQueryError::TQueryError(TZELStatusCode status, const std::string& message, std::size_t position)
    : TZELException(status), fMessage(message), fText("query, column " + std::to_string(position + 1) + ": " + message),
      fPosition(position)
{}

}  // namespace NORVZEL20

#include "host/TZELException.h"

namespace NORVZEL20 {

TZELException::TZELException(TZELStatusCode status) noexcept : fStatusCode(status) {}

TZELException::~TZELException() noexcept = default;

const char* TZELException::what() const noexcept
{
    return fStatusCode.TranslateStatusCode().c_str();
}

}  // namespace NORVZEL20

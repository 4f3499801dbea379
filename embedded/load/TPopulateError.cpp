#include "embedded/load/TPopulateError.h"

#include <utility>

namespace NORVZEL20 {

namespace {

std::string Compose(const std::string& message, const std::string& file, std::size_t line, std::size_t column)
{
    if (line == 0) {
        return file + ": " + message;
    }
    return file + ":" + std::to_string(line) + ":" + std::to_string(column) + ": " + message;
}

}  // namespace

TPopulateError::TPopulateError(TZELStatusCode status, std::string message, std::string file, std::size_t line, std::size_t column,
                               EAdvice advice)
    : TZELException(status), fMessage(std::move(message)), fFile(std::move(file)), fLine(line), fColumn(column), fAdvice(advice),
      fWhole(Compose(fMessage, fFile, fLine, fColumn))
{}

TPopulateError::~TPopulateError() noexcept = default;

}  // namespace NORVZEL20

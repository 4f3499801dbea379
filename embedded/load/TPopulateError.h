#pragma once

#include <cstddef>
#include <string>

#include "embedded/load/EAdvice.h"
#include "host/Export.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

/// Why a document could not be loaded, and where.
///
/// what() is the whole text for people: `file:line:column: message`, or `file: message` if no place applies.
/// The status is that of TNamespacePopulator::PopulateFromXMLFile.
class CIMDELTA_EXPORT TPopulateError : public TZELException {
  public:
    /// `line` and `column` count from 1; both are 0 if no place applies.
    TPopulateError(TZELStatusCode status, std::string message, std::string file, std::size_t line, std::size_t column,
                   EAdvice advice = EAdvice::kNone);
    TPopulateError(const TPopulateError& other) = default;
    TPopulateError& operator=(const TPopulateError& other) = default;
    ~TPopulateError() noexcept override;

    const char* what() const noexcept override { return fWhole.c_str(); }

    /// What was found and what was expected or can be done, without the place.
    const std::string& GetMessage() const noexcept { return fMessage; }
    /// The name under which the document was loaded.
    const std::string& GetFile() const noexcept { return fFile; }
    std::size_t GetLine() const noexcept { return fLine; }
    /// What can be done about it, for programs that have an option for it; the message says it without that option.
    EAdvice GetAdvice() const noexcept { return fAdvice; }
    /// Counted in bytes.
    std::size_t GetColumn() const noexcept { return fColumn; }

  private:
    std::string fMessage;
    std::string fFile;
    std::size_t fLine;
    std::size_t fColumn;
    EAdvice fAdvice;
    std::string fWhole;
};

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <string_view>

#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/load/TLoadContext.h"

namespace NORVZEL20 {

/// Reads what a message holds beside classes and instances: the name of the operation, output parameters, errors.
///
/// Errors: every operation that is said to fail does so through the context with kParseError (9).
class TCimXmlAnswerReader {
  public:
    explicit TCimXmlAnswerReader(TLoadContext& context) : fContext(context) {}

    /// IMETHODRESPONSE, the answer to an intrinsic operation.
    void Begin(const TCimXmlAttributes& attributes);
    void End() { fContext.GetContents().EndAnswer(); }
    /// PARAMVALUE in such an answer, and the text of its VALUE.
    void BeginOutput(const TCimXmlAttributes& attributes) { fOutput = attributes.Get("NAME"); }
    void EndOutput(std::string_view text);

    /// An element that holds no class and no instance is left out.
    void Skip(const TCimXmlAttributes& attributes);
    /// ERROR. Fails.
    [[noreturn]] void RefuseError(const TCimXmlAttributes& attributes) const;
    /// IMETHODCALL or METHODCALL. Fails.
    [[noreturn]] void RefuseRequest(const TCimXmlAttributes& attributes) const;

  private:
    TLoadContext& fContext;
    std::string fOperation;  // of the answer that was begun last
    std::string fOutput;     // the name of the parameter
};

}  // namespace NORVZEL20

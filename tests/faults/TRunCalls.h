#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// The calls that an untouched run over differing namespaces makes, as TCallWatch tells them, and what is to come of a run when
/// one of them fails. Knows nothing of any run that failed. Calls count from 1.
class TRunCalls {
  public:
    using EStatus = TZELStatusCode::EStatusCode;

    /// How a run ends.
    struct TEnd {
        std::string outcome;  ///< as OutcomeOf tells it
        std::string log;      ///< as TCapturingLogger tells it
    };

    TRunCalls() = default;
    /// `lines` as TCallWatch::GetText tells them, made under the specification `rules`.
    TRunCalls(const std::string& lines, const std::string& rules);

    std::size_t GetCount() const { return fLines.size(); }
    /// The call's line; "none" after the last one.
    std::string GetLine(std::size_t call) const;
    /// How many records have been added before the call.
    std::size_t CountRecordsBefore(std::size_t call) const;
    /// How the run ends when the call fails with that status.
    TEnd WhenFails(std::size_t call, EStatus status) const;

  private:
    /// Where the run is. Specification: in a class's start tag, in a value's end tag, in the end tag that pushes rules down.
    enum EPhase { kOperatingSystems, kClassTag, kValueTag, kPushingDown, kComparing };

    EPhase PhaseOf(std::size_t call) const;
    bool IsOfClassTag(std::size_t call) const;
    std::string LineInRules(std::size_t call) const;
    std::string PropertyOf(std::size_t call) const;
    TEnd WhenNotFound(std::size_t call) const;
    TEnd WhenNotFoundComparing(const std::string& line) const;

    std::vector<std::string> fLines;
    std::string fRules;
    std::size_t fFirstOfSpecification = 0;
    std::size_t fFirstCompared = 0;
};

}  // namespace NORVZEL20

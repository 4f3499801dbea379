#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// Predicts how a run ends if one of its host calls fails, from the calls that an untouched run makes. It never sees a run that
/// failed. Calls count from 1.
class TRunCalls {
  public:
    using EStatus = TZELStatusCode::EStatusCode;

    /// How a run ends.
    struct TEnd {
        std::string outcome;  ///< the text of OutcomeOf
        std::string log;      ///< the text of TCapturingLogger
    };

    TRunCalls() = default;
    /// `lines`: the text of TCallWatch::GetText after an untouched run with the specification `rules`.
    TRunCalls(const std::string& lines, const std::string& rules);

    std::size_t GetCount() const { return fLines.size(); }
    /// The line of the call, or "none" if there is no such call.
    std::string GetLine(std::size_t call) const;
    /// How many records the run has added before the call.
    std::size_t CountRecordsBefore(std::size_t call) const;
    /// How the run ends if the call fails with that status.
    TEnd WhenFails(std::size_t call, EStatus status) const;

  private:
    /// What the run is doing. It reads the specification in three places: a class's start tag, a value's end tag, and the end tag
    /// that pushes rules down.
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

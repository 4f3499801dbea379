#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/TDifferingRun.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TScratchFile.h"

namespace NORVZEL20 {

/// A run over differing namespaces while memory runs out.
class TFaultyRun : public IFaultyAction {
  public:
    /// Verify appends the number of records that Act left to `left`, unless that is its last entry or the run is a warm-up.
    TFaultyRun(const TDiffering& differing, const TUntouchedRun& expected, std::vector<std::size_t>& left);
    ~TFaultyRun() override;

    void Act() override;
    /// Checks that no log entry is cut, that the records are the first ones of the untouched run, that the delta namespace still
    /// works, and that another run is complete.
    void Verify(const std::string& outcome) override;

  private:
    void VerifyLog(const std::string& outcome);
    void VerifyRecords(const std::string& outcome, const std::vector<std::string>& records);

    TDiffering fDiffering;
    const TUntouchedRun& fExpected;
    std::vector<std::size_t>& fLeft;
    TCapturingLogger fLog;
    TScratchFile fRules;
    TCompared fCompared;
};

}  // namespace NORVZEL20

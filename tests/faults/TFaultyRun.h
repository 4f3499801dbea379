#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/TDifferingRun.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TScratchFile.h"

namespace NORVZEL20 {

/// A run over differing namespaces, to be done while memory runs out.
class TFaultyRun : public IFaultyAction {
  public:
    /// How many records Act leaves is appended to `left`, unless it is as many as stand there last or it passes the first times.
    TFaultyRun(const TDiffering& differing, const TUntouchedRun& expected, std::vector<std::size_t>& left);
    ~TFaultyRun() override;

    void Act() override;
    /// Checks that the log is whole, that the records written are the first ones of the untouched run, that the delta namespace
    /// answers, and that another run is whole.
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

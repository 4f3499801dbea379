#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "provider/TDeltaNamespace.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TScratchFile.h"

namespace NORVZEL20 {

/// What a run over differing namespaces comes to when nothing fails.
struct TUntouchedRun {
    std::vector<std::string> records;        ///< as TraceRecords tells them
    std::vector<std::string> secondRecords;  ///< of one more run
    std::string reference;                   ///< namespace 0 after both, as DumpDiffering tells it
    std::string aliases;                     ///< as DumpAliases tells them
};

/// A run over differing namespaces of the embedded host, to be done while memory runs out.
class TFaultyRun : public IFaultyAction {
  public:
    TFaultyRun(std::size_t namespaces, bool excludesKeys, const TUntouchedRun& expected);
    ~TFaultyRun() override;

    static TUntouchedRun DoUntouched(std::size_t namespaces, bool excludesKeys);

    void Act() override;
    /// Checks that the records written are the first ones of the untouched run, that the delta namespace answers, and that another
    /// run writes all of them.
    void Verify(const std::string& outcome) override;

  private:
    TFaultyRun(std::size_t namespaces, bool excludesKeys);

    std::vector<std::string> GetRecords() const;
    void VerifyAnotherRun(const std::vector<std::string>& before);

    TCapturingLogger fLog;
    TScratchFile fRules;
    boost::shared_ptr<TDeltaNamespace> fDelta;
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces;
    const TUntouchedRun* fExpected = nullptr;
};

/// Checks that `part` is what `whole` begins with.
void ExpectPrefix(const std::vector<std::string>& part, const std::vector<std::string>& whole);

/// Checks that a delta namespace of differing namespaces answers: the schema's classes, a wrapper, a query over `deltas` records.
void ExpectThatItAnswers(TDeltaNamespace& delta, std::size_t deltas);

}  // namespace NORVZEL20

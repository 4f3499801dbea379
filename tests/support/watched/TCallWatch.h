#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// Records the calls on a set of watched objects, one line each, in order. It can make calls fail.
///
/// A line has object, operation, arguments and context: `ns0:Disk.EnumerateInstances(false) {}`. Calls that the host itself makes
/// on a watched object (a path asks its class for the name) are not recorded and never fail.
class TCallWatch {
  public:
    /// Makes the `number`-th call fail with `status`, counted from 1 and from now. 0 makes none fail.
    void FailCall(std::size_t number, TZELStatusCode::EStatusCode status);
    /// Makes each call whose line begins with `start` fail with `status`, until StopFailing.
    void FailCallsOf(const std::string& start, TZELStatusCode::EStatusCode status);
    void StopFailing();

    /// Whether the call that FailCall ordered has failed.
    bool HasFailed() const { return fHasFailed; }
    std::size_t GetCount() const { return fLines.size(); }
    /// How many lines contain `text`.
    std::size_t CountOf(const std::string& text) const;
    /// The lines so far, each with a line end.
    std::string GetText() const;
    /// As GetText, and forgets the lines.
    std::string TakeText();
    void Forget() { fLines.clear(); }

    /// Records a call. Watched objects call this before they forward one. `caller` is the return address of their operation.
    /// Errors: TZELException if this call is to fail.
    void Called(const std::string& line, const void* caller = __builtin_return_address(0));

  private:
    std::vector<std::string> fLines;
    std::size_t fCallsUntilFailure = 0;
    bool fHasFailed = false;
    TZELStatusCode::EStatusCode fStatus = TZELStatusCode::kSuccess;
    std::string fFailingStart;
};

}  // namespace NORVZEL20

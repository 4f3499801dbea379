#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// What is known of the calls on a set of watched objects: each as one line, in order. Can make calls fail.
///
/// A line tells object, operation, arguments and context: `ns0:Disk.EnumerateInstances(false) {}`. Calls that the host itself makes
/// on a watched object (a path asks its class for the name) are neither written down nor made to fail.
class TCallWatch {
  public:
    /// From now on the `number`-th call (from 1, calls already made not counted) fails with `status`; 0: none does.
    void FailCall(std::size_t number, TZELStatusCode::EStatusCode status);
    /// Each call whose line begins with `start` fails with `status`, until StopFailing.
    void FailCallsOf(const std::string& start, TZELStatusCode::EStatusCode status);
    void StopFailing();

    /// Whether FailCall's call has come.
    bool HasFailed() const { return fHasFailed; }
    std::size_t GetCount() const { return fLines.size(); }
    /// How many lines contain `text`.
    std::size_t CountOf(const std::string& text) const;
    /// The lines so far, each with a line end.
    std::string GetText() const;
    /// GetText, and forgets the lines.
    std::string TakeText();
    void Forget() { fLines.clear(); }

    /// Told by an operation of a watched object, before the call is passed on. `caller` is where that operation returns to.
    /// Errors: TZELException where this call is to fail.
    void Called(const std::string& line, const void* caller = __builtin_return_address(0));

  private:
    std::vector<std::string> fLines;
    std::size_t fCallsUntilFailure = 0;
    bool fHasFailed = false;
    TZELStatusCode::EStatusCode fStatus = TZELStatusCode::kSuccess;
    std::string fFailingStart;
};

}  // namespace NORVZEL20

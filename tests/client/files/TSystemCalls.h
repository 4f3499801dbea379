#pragma once

#include <sys/types.h>

#include <functional>
#include <map>
#include <string>

namespace NORVZEL20 {

/// While this object lives, system calls of the client fail or fall short as the test asks. Calls by other libraries do not.
///
/// Threads: calls from several threads are counted together; functions given to Watch may then be called concurrently. Only one
/// object may live at a time.
class TSystemCalls {
  public:
    TSystemCalls();
    TSystemCalls(const TSystemCalls&) = delete;
    TSystemCalls& operator=(const TSystemCalls&) = delete;
    ~TSystemCalls();

    /// The `number`-th call of that name (from 1) fails with `error`: open, read, pread, memfd_create, mkostemp, write, fchmod,
    /// fsync, close, rename.
    void Fail(const std::string& call, int number, int error);
    /// From now on a read or write transfers at most so many bytes.
    void LimitPieces(std::size_t length) { fPiece = length; }
    /// From now on `before` is called before each call of that name, with the number of the call.
    void Watch(const std::string& call, const std::function<void(int number)>& before) { fWatches[call] = before; }

    /// How many calls of that name there have been.
    int GetCount(const std::string& call) const;

    /// Called by each wrapped function first. Returns 0, or the errno with which the function is to fail.
    static int Enter(const char* call);
    /// How many of `size` bytes a read or write may transfer.
    static std::size_t Limit(std::size_t size);

  private:
    struct TFault {
        int number;
        int error;
    };
    int EnterCall(const std::string& call);

    std::map<std::string, TFault> fFaults;
    std::map<std::string, int> fCounts;
    std::map<std::string, std::function<void(int)>> fWatches;
    std::size_t fPiece = 0;
};

}  // namespace NORVZEL20

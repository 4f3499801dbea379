#pragma once

#include <sys/types.h>

#include <functional>
#include <map>
#include <string>

namespace NORVZEL20 {

/// While it lives, the client's calls of the operating system go wrong as the test wants it. Other libraries' calls are left alone.
///
/// Threads: the calls of several may be hooked, if the functions given can stand it; one object at a time.
class TSystemCalls {
  public:
    TSystemCalls();
    TSystemCalls(const TSystemCalls&) = delete;
    TSystemCalls& operator=(const TSystemCalls&) = delete;
    ~TSystemCalls();

    /// The `number`-th call of that name (from 1) fails with `error`: open, read, mkostemp, write, fchmod, fsync, close, rename.
    void Fail(const std::string& call, int number, int error);
    /// Reading and writing take at most so many bytes at a time.
    void LimitPieces(std::size_t length) { fPiece = length; }
    /// `before` is called before each call of that name, with its number.
    void Watch(const std::string& call, const std::function<void(int number)>& before) { fWatches[call] = before; }

    int GetCount(const std::string& call) const;

    /// What each hooked call asks first: 0, or what it is to fail with.
    static int Enter(const char* call);
    /// How much of `size` bytes is to be read or written.
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

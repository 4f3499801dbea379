#pragma once

#include <stdexcept>
#include <string>

namespace NORVZEL20 {

/// Thrown by a fuzz target if the code under test broke a promise. Nothing else may leave a target.
class TBrokenPromise : public std::logic_error {
  public:
    explicit TBrokenPromise(const std::string& what) : std::logic_error(what) {}
};

/// Throws TBrokenPromise with `promise`, and with what was seen instead, unless `held`.
inline void Promise(bool held, const std::string& promise, const std::string& seen = std::string())
{
    if (!held) {
        throw TBrokenPromise(seen.empty() ? promise : promise + "\n" + seen);
    }
}

/// Throws TBrokenPromise with both texts unless they are the same.
inline void PromiseEqual(const std::string& expected, const std::string& actual, const std::string& promise)
{
    Promise(expected == actual, promise, "--- one:\n" + expected + "\n--- other:\n" + actual);
}

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// The lines of a file that a reader could not take. It leaves them out and goes on with the next one.
class TReadFaults {
  public:
    /// Notes a line, counted from 1, and what is wrong with it: "found X, expected Y".
    void Add(std::size_t line, const std::string& reason)
    {
        if (fCount++ == 0) {
            fFirst = "line " + std::to_string(line) + ": " + reason;
        }
    }

    std::size_t GetCount() const noexcept { return fCount; }
    /// The first one with its line; empty if there is none.
    const std::string& GetFirst() const noexcept { return fFirst; }

  private:
    std::size_t fCount = 0;
    std::string fFirst;
};

}  // namespace NORVZEL20

#pragma once

#include <unistd.h>

#include <utility>

namespace NORVZEL20 {

/// An open file that is closed with this object; -1 stands for none.
class TDescriptor {
  public:
    explicit TDescriptor(int number = -1) noexcept : fNumber(number) {}
    TDescriptor(TDescriptor&& other) noexcept : fNumber(std::exchange(other.fNumber, -1)) {}
    TDescriptor& operator=(TDescriptor&& other) noexcept
    {
        std::swap(fNumber, other.fNumber);
        return *this;
    }
    ~TDescriptor()
    {
        if (fNumber >= 0) {
            close(fNumber);
        }
    }

    explicit operator bool() const noexcept { return fNumber >= 0; }
    int Get() const noexcept { return fNumber; }
    /// Leaves the closing to the caller.
    int Release() noexcept { return std::exchange(fNumber, -1); }

  private:
    int fNumber;
};

}  // namespace NORVZEL20

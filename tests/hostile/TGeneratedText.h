#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace NORVZEL20 {

/// A text of any length that is never held: a beginning, a unit so many times over, and an end.
class TGeneratedText {
  public:
    TGeneratedText(std::string beginning, std::string unit, std::uint64_t times, std::string end)
        : fBeginning(std::move(beginning)), fUnit(std::move(unit)), fTimes(times), fEnd(std::move(end))
    {}

    /// Fills the buffer with the next bytes and returns how many; 0 at the end.
    std::size_t Pull(char* buffer, std::size_t size);

    /// How many bytes have been taken.
    std::uint64_t GetPulled() const { return fPulled; }
    std::uint64_t GetLength() const { return fBeginning.size() + fUnit.size() * fTimes + fEnd.size(); }

  private:
    char At(std::uint64_t position) const;

    std::string fBeginning;
    std::string fUnit;
    std::uint64_t fTimes;
    std::string fEnd;
    std::uint64_t fPulled = 0;
};

}  // namespace NORVZEL20

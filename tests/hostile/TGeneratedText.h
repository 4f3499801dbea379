#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace NORVZEL20 {

/// A text of any length that is never in memory as a whole: a beginning, a unit many times, and an end.
class TGeneratedText {
  public:
    TGeneratedText(std::string beginning, const std::string& unit, std::uint64_t times, std::string end);

    /// Fills the buffer with the next bytes and returns how many; 0 at the end.
    std::size_t Pull(char* buffer, std::size_t size);

    /// How many bytes have been taken.
    std::uint64_t GetPulled() const { return fPulled; }
    std::uint64_t GetLength() const { return fBeginning.size() + fMiddleSize + fEnd.size(); }

  private:
    std::string_view At(std::uint64_t position) const;

    std::string fBeginning;
    std::string fUnits;  // several, to be copied at once
    std::size_t fUnitSize;
    std::uint64_t fMiddleSize;
    std::string fEnd;
    std::uint64_t fPulled = 0;
};

}  // namespace NORVZEL20

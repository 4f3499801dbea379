#pragma once

#include <cstddef>
#include <string_view>

namespace NORVZEL20 {

/// The lines of a text one after the other, without their ends, with the number of the current one.
class TTextLines {
  public:
    explicit TTextLines(std::string_view text) : fRest(text) {}

    /// Goes to the next line. Returns false at the end.
    bool Next()
    {
        if (fRest.empty()) {
            return false;
        }
        const std::size_t end = fRest.find('\n');
        fLine = fRest.substr(0, end);
        fRest.remove_prefix(end == std::string_view::npos ? fRest.size() : end + 1);
        ++fNumber;
        return true;
    }

    std::string_view GetLine() const noexcept { return fLine; }
    std::size_t GetNumber() const noexcept { return fNumber; }

  private:
    std::string_view fRest;
    std::string_view fLine;
    std::size_t fNumber = 0;
};

}  // namespace NORVZEL20

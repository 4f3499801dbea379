#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>

#include "client/files/TSpooledText.h"

namespace NORVZEL20 {

/// The texts of a page, each once. A text is known by its number; 0 is the empty text.
///
/// Memory: each text once, for the look-up; the page's own copy is spooled.
class TPageTexts {
  public:
    TPageTexts();

    /// The number of the text. Bytes that are not UTF-8 are escaped.
    std::uint32_t Add(std::string_view text);

    /// The texts behind each other, in the order of their numbers.
    const TSpooledText& GetTexts() const { return fTexts; }
    /// Their lengths as little-endian numbers of 32 bits. They count UTF-16, because JavaScript does.
    const TSpooledText& GetLengths() const { return fLengths; }
    std::size_t GetCount() const { return fNumbers.size(); }

  private:
    std::unordered_map<std::string, std::uint32_t> fNumbers;
    TSpooledText fTexts;
    TSpooledText fLengths;
};

}  // namespace NORVZEL20

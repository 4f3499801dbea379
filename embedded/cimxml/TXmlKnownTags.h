#pragma once

#include <cstddef>
#include <memory>
#include <string_view>
#include <unordered_map>

#include "embedded/cimxml/EXmlScan.h"
#include "embedded/cimxml/TXmlStartTag.h"
#include "embedded/cimxml/TXmlTag.h"

namespace NORVZEL20 {

/// Reads start tags, and knows those again that it has read before.
///
/// An inventory consists of few tags that come again and again, byte for byte the same and mostly in the same order. Each known tag
/// remembers which tag came after it, and which one after that. So the next tag is mostly guessed, and comparing the bytes is all
/// that is left of reading it. The number of known tags and their lengths are bounded; a tag beyond the bounds is read anew each
/// time.
class TXmlKnownTags {
  public:
    static constexpr std::size_t kMost = 4096;
    static constexpr std::size_t kLongest = 256;  ///< bytes of a tag

    /// A tag, and what tends to come after it.
    struct TKnown {
        TXmlTag tag;
        std::size_t number = kMost;  ///< in the order in which the tags became known; kMost if the tag is not kept
        TKnown* next = nullptr;
        TKnown* nextButOne = nullptr;
    };

    TXmlKnownTags() = default;
    TXmlKnownTags(const TXmlKnownTags&) = delete;
    TXmlKnownTags& operator=(const TXmlKnownTags&) = delete;

    /// Reads the tag whose '<' is at `from` and returns it, or null if it is not accepted; `scan` then says why. The bytes end at
    /// `end`, and TXmlWindow::kPad zeros follow. A tag that is not kept is valid until the next call. Errors: std::bad_alloc.
    TKnown* Read(const char* from, const char* end, EXmlScan& scan);

    /// A document begins: its tags follow none of the last one's.
    void BeginDocument() noexcept { fLast = fLastButOne = nullptr; }

  private:
    TKnown* Guess(const char* from, const char* end) const noexcept;
    TKnown* Find(const char* from, const char* end) const;
    TKnown* Learn();

    std::unordered_map<std::string_view, std::unique_ptr<TKnown>> fKnown;  // by their bytes
    TKnown* fLast = nullptr;
    TKnown* fLastButOne = nullptr;
    TXmlStartTag fTag;
    TKnown fUnknown;  // for a tag that is not kept
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/cimxml/TXmlStartTag.h"

namespace NORVZEL20 {

/// A start tag in the form in which it is handed out: names and values end with a NUL, and values mean what they say.
class TXmlTag {
  public:
    TXmlTag() = default;
    TXmlTag(const TXmlTag&) = delete;
    TXmlTag& operator=(const TXmlTag&) = delete;

    /// Takes over a tag that was accepted. Errors: std::bad_alloc.
    void Assign(const TXmlStartTag& tag);

    /// The tag as the document writes it. TXmlSearch::kReadsBeyond bytes behind it may be read.
    std::string_view GetBytes() const noexcept { return std::string_view(fBytes.data(), fLength); }
    const char* GetName() const noexcept { return fText.data(); }
    std::size_t GetNameLength() const noexcept { return fNameLength; }
    /// Names and values in turn, then null. Valid until the next Assign.
    const char** GetAttributes() noexcept { return fAttributes.data(); }
    bool IsEmpty() const noexcept { return fIsEmpty; }

  private:
    const char* AddText(std::string_view text);
    const char* AddValue(std::string_view value);

    std::string fBytes;
    std::size_t fLength = 0;
    std::string fText;  // the name, then the names and values of the attributes
    std::size_t fNameLength = 0;
    std::vector<const char*> fAttributes;
    bool fIsEmpty = false;
};

}  // namespace NORVZEL20

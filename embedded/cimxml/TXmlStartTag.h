#pragma once

#include <string_view>
#include <vector>

#include "embedded/cimxml/EXmlScan.h"

namespace NORVZEL20 {

/// Finds out whether a start tag is one that the tokenizer accepts, and where its parts are. The views are into the document.
class TXmlStartTag {
  public:
    struct TAttribute {
        std::string_view name;
        std::string_view value;  ///< between the quotes, as written
        bool isPlain;            ///< the value means what is written: no references, line ends, tabs or characters beyond ASCII
    };

    /// Reads the tag whose '<' is at `from`. The bytes end at `end`, and a NUL is there. Errors: std::bad_alloc.
    EXmlScan Read(const char* from, const char* end);

    /// What was read last; only if it was accepted.
    std::string_view GetBytes() const noexcept { return fBytes; }
    std::string_view GetName() const noexcept { return fName; }
    const std::vector<TAttribute>& GetAttributes() const noexcept { return fAttributes; }
    bool IsEmpty() const noexcept { return fIsEmpty; }

  private:
    EXmlScan ReadName(std::string_view& name);
    EXmlScan ReadAttributes();
    EXmlScan ReadAttribute();
    EXmlScan ReadValue(TAttribute& attribute, char quote);
    EXmlScan PassSpecial();
    bool IsRepeated(std::string_view name) const noexcept;
    bool SkipBlanks() noexcept;
    EXmlScan Miss() const noexcept { return fAt >= fEnd ? EXmlScan::kCutOff : EXmlScan::kRefused; }

    const char* fAt = nullptr;
    const char* fEnd = nullptr;
    std::string_view fBytes;
    std::string_view fName;
    std::vector<TAttribute> fAttributes;
    bool fIsEmpty = false;
};

}  // namespace NORVZEL20

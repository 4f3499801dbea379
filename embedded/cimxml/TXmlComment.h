#pragma once

#include "embedded/cimxml/EXmlScan.h"

namespace NORVZEL20 {

/// A comment: <!-- text without two hyphens in a row -->
class TXmlComment {
  public:
    TXmlComment() = delete;

    /// Moves `at`, behind the "<!--", over the rest of the comment. The bytes end at `end`, and TXmlWindow::kPad zeros follow.
    static EXmlScan Pass(const char*& at, const char* end) noexcept;
};

}  // namespace NORVZEL20

#pragma once

#include <string_view>

namespace NORVZEL20 {

// The sources of the page beside this header, as they were when the program was built.

/// report.html, with marks such as {{style}} where the rest goes.
std::string_view PageMarkup();
/// report.css
std::string_view PageStyle();
/// The scripts, one behind the other.
std::string_view PageScript();

}  // namespace NORVZEL20

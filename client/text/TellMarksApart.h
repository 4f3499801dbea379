#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// Values that differ, as they are shown: unless all have the same marks in the same order, the marks become escapes in each.
/// A mark is a character that joins the one before it (an accent, U+0301) or a sign that looks like a letter (U+212B). A letter
/// with an accent may be one character or two, which look alike: `é -> e\u0301`. The texts must be valid UTF-8. A second call
/// changes nothing.
void TellMarksApart(std::vector<std::string>& texts);

}  // namespace NORVZEL20

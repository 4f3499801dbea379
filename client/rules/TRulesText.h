#pragma once

#include <string>

namespace NORVZEL20 {

/// Rules as they were read or made.
struct TRulesText {
    std::string name;     ///< what messages call them: the path of the file, or "standard input"
    std::string text;     ///< the whole document
    bool isMade = false;  ///< made by cimdelta, because the person named no rules
};

}  // namespace NORVZEL20

#pragma once

#include <string>

namespace NORVZEL20 {

/// Rules as they were read or made.
struct TRulesText {
    std::string name;  ///< what messages call them: the path of the file, or "standard input"
    std::string text;  ///< the whole document
};

}  // namespace NORVZEL20

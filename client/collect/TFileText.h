#pragma once

#include <string>

namespace NORVZEL20 {

/// What became of reading a file.
struct TFileText {
    std::string text;        ///< all of it; empty if there was trouble
    std::string trouble;     ///< why it could not be read, for people; empty if it could
    bool isMissing = false;  ///< the trouble is that there is no such file
};

}  // namespace NORVZEL20

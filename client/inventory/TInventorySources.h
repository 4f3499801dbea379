#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// What an argument of the command line that names an inventory stands for. A plain value.
struct TInventorySources {
    std::string argument;            ///< as it was given
    std::string label;               ///< the label in front of it; empty if there is none
    std::string firstSource;         ///< the path of its first file or folder; gives the label otherwise
    std::vector<std::string> files;  ///< what is loaded, in that order; "-" is standard input
};

}  // namespace NORVZEL20

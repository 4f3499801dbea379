#pragma once

#include <string>

namespace NORVZEL20 {

/// A command that is started at given times.
struct TJob {
    std::string schedule;  ///< in the words of its file
    std::string user;      ///< empty if the file does not say
    std::string command;
};

}  // namespace NORVZEL20

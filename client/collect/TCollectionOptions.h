#pragma once

#include <chrono>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// What is collected.
struct TCollectionOptions {
    std::vector<std::string> only;     ///< kinds; empty: all
    std::vector<std::string> skipped;  ///< kinds
    std::vector<std::string>
        excluded;  ///< shell patterns of paths of configuration files and of files with certificates; * also stands for slashes
    bool hasRootFiles = false;  ///< whether files that only root may read are collected too, if they can be read
    std::chrono::seconds timeLimit{120};
};

}  // namespace NORVZEL20

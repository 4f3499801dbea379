#pragma once

#include <string>

namespace NORVZEL20 {

/// An installed package of rpm.
struct TRpmPackage {
    std::string name;
    std::string version;  ///< with the epoch, if there is one, and the release: 1:2.3-4.el9
    std::string architecture;
    std::string source;  ///< the name of the source package's file
    std::string vendor;
};

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// How the inventories of a command are loaded: the options that all commands share, as they were typed. A plain value.
struct TLoadingOptions {
    /// `[LABEL=]NAME`: the namespace of inventories that name none. One without a label is for all that have no one of their own.
    std::vector<std::string> namespaces;
};

}  // namespace NORVZEL20

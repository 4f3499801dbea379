#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// What a load found. A plain value.
struct TLoadReport {
    /// One kind of oddity that was put up with.
    struct TTolerated {
        std::string text;   ///< what was found and how it was taken, with the first place's names
        std::size_t line;   ///< the line of the first one, from 1
        std::size_t count;  ///< how many of this kind there were
    };

    std::string namespaceName = "root/cimv2";  ///< the namespace that the document names, or that default
    bool namesNamespace = false;               ///< whether the document names its namespace
    std::string host;                          ///< the host beside that namespace; empty where none is named
    std::size_t qualifierDecls = 0;
    std::size_t classes = 0;
    std::size_t instances = 0;
    std::vector<TTolerated> tolerated;  ///< one entry for each kind, in the order of first appearance
};

}  // namespace NORVZEL20

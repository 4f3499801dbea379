#pragma once

#include <string>

namespace NORVZEL20 {

/// Who asks a server. A plain value.
struct TWbemCredentials {
    std::string user;  ///< empty: nobody in particular
    std::string password;
};

}  // namespace NORVZEL20

#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "client/wbem/TWbemCredentials.h"

namespace NORVZEL20 {

/// Posts requests to one server. Tests replace it.
///
/// Threads: one at a time.
class IHttpTransport {
  public:
    struct TPost {
        std::vector<std::string> headers;  ///< "Name: value"
        std::string body;
        std::chrono::milliseconds most;  ///< that it may take
    };

    struct TAnswer {
        long status = 0;
        std::string reason;    ///< behind the status in its line
        std::string cimError;  ///< the header of that name
        std::string location;  ///< likewise
    };

    using TSink = std::function<void(std::string_view)>;

    virtual ~IHttpTransport() = default;

    /// Posts a request. The sink gets the body of an answer whose status is 2xx, piece by piece.
    /// Errors: TWbemFault; what the sink throws.
    virtual TAnswer Post(const TPost& post, const TSink& sink) = 0;

    /// From now on asks as that user.
    virtual void SetCredentials(const TWbemCredentials& credentials) = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <chrono>
#include <functional>
#include <optional>
#include <string>

#include "client/wbem/IHttpTransport.h"
#include "client/wbem/TAnswerStore.h"
#include "client/wbem/TWbemAddress.h"
#include "client/wbem/TWbemAnswer.h"
#include "client/wbem/TWbemCounts.h"
#include "client/wbem/TWbemCredentials.h"
#include "client/wbem/TWbemFault.h"
#include "client/wbem/TWbemLimits.h"
#include "client/wbem/TWbemRequest.h"

namespace NORVZEL20 {

/// A WBEM server that requests of CIM (DSP0200) are sent to: within limits, and again if a connection fails.
///
/// Threads: one at a time.
class TWbemServer {
  public:
    struct TSettings {
        TWbemAddress address;
        TWbemLimits limits;
        TWbemCredentials credentials;   ///< without a user: the server is asked without any, unless the transport knows one
        std::string credentialsOrigin;  ///< where a user would come from, for messages: "~/.netrc"; empty for nowhere
        /// Asks the person who runs the program for what `credentials` lacks, or returns nothing. Called once at most, if the
        /// server wants a user.
        std::function<std::optional<TWbemCredentials>(const TWbemCredentials& known)> askPerson;
        std::function<void(std::chrono::milliseconds)> sleep;  ///< tests replace it; empty: sleeps
    };

    /// The transport must outlive this.
    TWbemServer(IHttpTransport& transport, TSettings settings);

    /// Sends a request and keeps the answer in `store`, unless that is null. A request that is repeatable is sent again, after a
    /// pause, if the connection fails or the server is busy; not after an error of CIM or a refused user.
    /// Errors: TWbemFault, nothing is kept then; TClientError; std::bad_alloc.
    TWbemAnswer Ask(const TWbemRequest& request, TAnswerStore* store = nullptr);

    /// Waits as in front of a repeated request: the longer, the more tries there were. Errors: TWbemFault if the time is up.
    void Pause(unsigned int tries);

    const TWbemLimits& GetLimits() const noexcept { return fSettings.limits; }
    const TWbemAddress& GetAddress() const noexcept { return fSettings.address; }
    TWbemCounts& GetCounts() noexcept { return fCounts; }

  private:
    TWbemAnswer AskOnce(const TWbemRequest& request, TAnswerStore* store);
    IHttpTransport::TAnswer Post(const TWbemRequest& request, const IHttpTransport::TSink& sink);
    bool TryOtherCredentials();
    void CheckStatus(const IHttpTransport::TAnswer& answer, const std::string& place) const;
    std::string DescribeRefusedUser(const IHttpTransport::TAnswer& answer) const;
    void CountInstance();
    void CountBytes(std::size_t count, std::uint64_t& ofAnswer);
    std::chrono::milliseconds GetRest(std::chrono::milliseconds least = {}) const;

    IHttpTransport& fTransport;
    TSettings fSettings;
    TWbemCounts fCounts;
    const std::chrono::steady_clock::time_point fEnd;
};

}  // namespace NORVZEL20

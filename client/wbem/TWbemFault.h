#pragma once

#include <string>
#include <utility>

#include "client/process/TClientError.h"

namespace NORVZEL20 {

/// Why a request to a server failed. what() is the whole message.
class TWbemFault : public TClientError {
  public:
    enum EKind : unsigned char {
        kUnreachable,  ///< there is no connection
        kBroken,       ///< the connection ended in the middle, or the server is busy
        kSilent,       ///< the server took longer than TWbemLimits::silence
        kAnswer,       ///< the answer is of no use
        kStatus,       ///< the answer is an error of CIM
        kFinal         ///< no request will succeed, for instance since the certificate is not trusted or a limit is reached
    };

    /// `place` is the server, or what was asked for. `status` is the number of the error of CIM.
    TWbemFault(EKind kind, const std::string& place, std::string reason, std::string status = std::string())
        : TClientError(place + ": " + reason), fKind(kind), fReason(std::move(reason)), fStatus(std::move(status))
    {}

    EKind GetKind() const noexcept { return fKind; }
    /// The message without the place.
    const std::string& GetReason() const noexcept { return fReason; }
    /// Empty unless the kind is kStatus.
    const std::string& GetStatus() const noexcept { return fStatus; }

    /// Whether the same request may succeed a moment later.
    bool MayPass() const noexcept { return fKind == kUnreachable || fKind == kBroken; }
    /// Whether another request may succeed.
    bool IsOfThisRequest() const noexcept { return fKind != kUnreachable && fKind != kFinal; }

  private:
    EKind fKind;
    std::string fReason;
    std::string fStatus;
};

}  // namespace NORVZEL20

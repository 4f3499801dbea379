#pragma once

#include <memory>
#include <string>

#include "client/wbem/IHttpTransport.h"
#include "client/wbem/TWbemAddress.h"
#include "client/wbem/TWbemLimits.h"

namespace NORVZEL20 {

/// Posts over HTTP or HTTPS with libcurl.
///
/// Certificates and the names in them are always checked. Redirections are not followed. Connections stay open between requests.
/// Proxies are those of the environment (https_proxy, http_proxy, no_proxy), and none for a server on this machine.
class TCurlTransport : public IHttpTransport {
  public:
    struct TSettings {
        TWbemAddress address;
        std::string caFile;     ///< the authorities that are trusted; empty: those of the system
        bool hasNetrc = false;  ///< user and password are taken from a file of netrc
        std::string netrcFile;  ///< empty: ~/.netrc
        TWbemLimits limits;
    };

    /// Errors: TClientError if curl cannot be set up; std::bad_alloc.
    explicit TCurlTransport(TSettings settings);
    TCurlTransport(const TCurlTransport&) = delete;
    TCurlTransport& operator=(const TCurlTransport&) = delete;
    ~TCurlTransport() override;

    TAnswer Post(const TPost& post, const TSink& sink) override;
    void SetCredentials(const TWbemCredentials& credentials) override;

  private:
    struct TCurl;
    struct TTransfer;

    template <class TValue>
    void Set(int option, TValue value);
    void SetUp();
    [[noreturn]] void Fail(int code, const TTransfer& transfer);

    const TSettings fSettings;
    std::unique_ptr<TCurl> fCurl;
};

}  // namespace NORVZEL20

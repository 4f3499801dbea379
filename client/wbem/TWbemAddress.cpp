#include "client/wbem/TWbemAddress.h"

#include <curl/curl.h>

#include <boost/algorithm/string/predicate.hpp>
#include <boost/algorithm/string/trim.hpp>
#include <memory>
#include <new>

#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

const char kExpectedAddress[] = "expected an address such as https://array1:5989";

// The address without what stands between "//" and "@".
std::string HideUser(const std::string& text)
{
    const std::size_t end = text.rfind('@');
    if (end == std::string::npos) {
        return text;
    }
    const std::size_t begin = text.find("//");
    return (begin < end ? text.substr(0, begin + 2) : std::string()) + "..." + text.substr(end);
}

// The parts of an address, as curl reads them.
class TUrl {
  public:
    explicit TUrl(const std::string& text) : fHandle(curl_url(), &curl_url_cleanup)
    {
        if (!fHandle) {
            throw std::bad_alloc();
        }
        fIsValid = curl_url_set(fHandle.get(), CURLUPART_URL, text.c_str(), CURLU_NON_SUPPORT_SCHEME) == CURLUE_OK;
    }

    bool IsValid() const noexcept { return fIsValid; }

    // Empty if the address has no such part.
    std::string Get(CURLUPart part) const
    {
        char* value = nullptr;
        if (curl_url_get(fHandle.get(), part, &value, 0) != CURLUE_OK) {
            return std::string();
        }
        const std::unique_ptr<char, decltype(&curl_free)> owner(value, &curl_free);
        return value;
    }

  private:
    std::unique_ptr<CURLU, decltype(&curl_url_cleanup)> fHandle;
    bool fIsValid = false;
};

void RequirePlainParts(const TUrl& url, const std::string& text)
{
    if (!url.Get(CURLUPART_USER).empty() || !url.Get(CURLUPART_PASSWORD).empty()) {
        throw TClientError(EscapeForDisplay(HideUser(text)) +
                           ": found a user name or password in the address, where other users of this machine can read it;"
                           " give them with --netrc, in CIMDELTA_USER and CIMDELTA_PASSWORD, or when asked");
    }
    if (!url.Get(CURLUPART_QUERY).empty() || !url.Get(CURLUPART_FRAGMENT).empty()) {
        throw TClientError(EscapeForDisplay(text) + ": found \"?\" or \"#\" in the address, " + kExpectedAddress);
    }
}

bool IsLoopback(const std::string& host)
{
    return boost::algorithm::iequals(host, "localhost") || host == "::1" ||
           (boost::algorithm::starts_with(host, "127.") && host.find_first_not_of("0123456789.") == std::string::npos);
}

}  // namespace

TWbemAddress ReadWbemAddress(const std::string& text)
{
    const TUrl url(text);
    const std::string scheme = url.Get(CURLUPART_SCHEME);
    if (!url.IsValid() || (scheme != "http" && scheme != "https")) {
        throw TClientError(EscapeForDisplay(HideUser(text)) + ": found no address of http or https, " + kExpectedAddress);
    }
    RequirePlainParts(url, text);
    TWbemAddress address;
    address.isSecure = scheme == "https";
    const std::string host = url.Get(CURLUPART_HOST);
    address.host = boost::algorithm::trim_copy_if(host, [](char c) { return c == '[' || c == ']'; });
    const std::string port = url.Get(CURLUPART_PORT);
    address.server = scheme + "://" + host + ":" + (port.empty() ? (address.isSecure ? "5989" : "5988") : port);
    const std::string path = url.Get(CURLUPART_PATH);
    address.url = address.server + (path.empty() || path == "/" ? "/cimom" : path);
    address.isLoopback = IsLoopback(address.host);
    return address;
}

std::string ReadNamespaceName(const std::string& text)
{
    const std::string name = boost::algorithm::trim_copy_if(text, [](char c) { return c == '/'; });
    if (name.empty() || name.find("//") != std::string::npos) {
        throw TClientError(QuoteForDisplay(text) + " is no namespace; name one such as root/cimv2");
    }
    return name;
}

}  // namespace NORVZEL20

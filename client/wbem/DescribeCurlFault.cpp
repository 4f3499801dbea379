#include "client/wbem/DescribeCurlFault.h"

#include <curl/curl.h>

#include <algorithm>
#include <system_error>

#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

// Numbers of OpenSSL (x509_vfy.h), which libcurl hands on.
// libcurl has 1 while nothing was checked, and checks the name first.
const long kNotChecked = 1;
const long kNotYetValid = 9;
const long kExpired = 10;

std::string Seconds(std::chrono::milliseconds time)
{
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(time).count();
    return std::to_string(seconds) + " s";
}

// Why there is no connection, in the system's words if it has some.
std::string WhyNoConnection(const TCurlFault& fault)
{
    if (fault.systemError != 0) {
        return std::error_code(static_cast<int>(fault.systemError), std::generic_category()).message();
    }
    return EscapeForDisplay(fault.words);
}

std::string DescribeCertificate(const TCurlFault& fault, const TCurlTransport::TSettings& settings)
{
    if (fault.certificateError <= kNotChecked) {
        const std::string whose = fault.certificateNames.empty() ? "" : " (" + EscapeForDisplay(fault.certificateNames) + ")";
        return "found the certificate of another host" + whose + ", expected one for " + EscapeForDisplay(settings.address.host) +
               "; ask for the server by a name that is in its certificate";
    }
    if (fault.certificateError == kExpired || fault.certificateError == kNotYetValid) {
        return std::string("found a certificate that ") +
               (fault.certificateError == kExpired ? "has expired" : "is not valid yet") +
               "; let the server have a new one, or set the clock of this machine";
    }
    if (!settings.caFile.empty()) {
        return "found a certificate that no authority in " + EscapeForDisplay(settings.caFile) +
               " has signed; give the certificate of the right one with --ca FILE";
    }
    return "found a certificate of an authority that is not known here; give the authority's certificate, or the server's own if it"
           " is self-signed, with --ca FILE";
}

std::string DescribeEmptyAnswer(const TCurlTransport::TSettings& settings)
{
    return settings.address.isSecure
               ? "the connection was closed without an answer"
               : "the connection was closed without an answer; if the server speaks TLS there, ask it as https://";
}

TWbemFault DescribeSilence(const TCurlFault& fault, const TCurlTransport::TSettings& settings)
{
    const std::string server = EscapeForDisplay(settings.address.server);
    const TWbemLimits& limits = settings.limits;
    if (!fault.isConnected) {
        return {TWbemFault::kFinal, server,
                "no connection within " + Seconds(std::min(limits.connecting, limits.silence)) +
                    "; is the server running, and is that its port?"};
    }
    return {TWbemFault::kSilent, server,
            "the server was silent for " + Seconds(limits.silence) + "; allow it more with --timeout SECONDS"};
}

}  // namespace

TWbemFault DescribeCurlFault(const TCurlFault& fault, const TCurlTransport::TSettings& settings)
{
    const std::string server = EscapeForDisplay(settings.address.server);
    const std::string host = EscapeForDisplay(settings.address.host);
    switch (fault.code) {
    case CURLE_COULDNT_RESOLVE_HOST:
        return {TWbemFault::kFinal, server, "no address is known for " + host + "; correct the name, or name the address itself"};
    case CURLE_COULDNT_RESOLVE_PROXY:
        return {TWbemFault::kFinal, server, "no address is known for the proxy; correct https_proxy or http_proxy"};
    case CURLE_COULDNT_CONNECT:
        return {TWbemFault::kUnreachable, server,
                "no connection: " + WhyNoConnection(fault) + "; is the server running, and is that its port?"};
    case CURLE_PEER_FAILED_VERIFICATION:
        return {TWbemFault::kFinal, server, DescribeCertificate(fault, settings)};
    case CURLE_SSL_CACERT_BADFILE:
        return {TWbemFault::kFinal, EscapeForDisplay(settings.caFile),
                "found no certificate there, expected those of authorities in PEM; correct --ca"};
    case CURLE_SSL_CONNECT_ERROR:
        return {TWbemFault::kFinal, server,
                "no TLS connection: " + EscapeForDisplay(fault.words) +
                    "; if the server does not speak TLS at that port, ask it as http:// or at another port"};
    case CURLE_OPERATION_TIMEDOUT:
        return DescribeSilence(fault, settings);
    case CURLE_GOT_NOTHING:
        return {TWbemFault::kBroken, server, DescribeEmptyAnswer(settings)};
    case CURLE_PARTIAL_FILE:
    case CURLE_RECV_ERROR:
    case CURLE_SEND_ERROR:
        return {TWbemFault::kBroken, server,
                (fault.hasAnswerBegun ? "the connection ended in the middle of an answer" : DescribeEmptyAnswer(settings))};
    case CURLE_UNSUPPORTED_PROTOCOL:
    case CURLE_WEIRD_SERVER_REPLY:
        return {TWbemFault::kFinal, server, "found an answer that is not HTTP; is this the port of a WBEM server?"};
    default:
        return {TWbemFault::kAnswer, server, EscapeForDisplay(fault.words)};
    }
}

}  // namespace NORVZEL20

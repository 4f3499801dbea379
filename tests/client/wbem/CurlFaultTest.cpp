#include <cerrno>
#include <curl/curl.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "client/wbem/DescribeCurlFault.h"

namespace NORVZEL20 {
namespace {

struct TCurlFaultRow {
    const char* what;
    const char* address;
    TCurlFault fault;
    TWbemFault::EKind kind;
    std::string message;
};

TCurlFault Fault(CURLcode code, const std::string& words = "curl's words")
{
    TCurlFault fault;
    fault.code = code;
    fault.words = words;
    return fault;
}

TCurlFault Certificate(long error, const std::string& names = "")
{
    TCurlFault fault = Fault(CURLE_PEER_FAILED_VERIFICATION);
    fault.certificateError = error;
    fault.certificateNames = names;
    return fault;
}

TCurlFault Connection(long error)
{
    TCurlFault fault = Fault(CURLE_COULDNT_CONNECT);
    fault.systemError = error;
    return fault;
}

TCurlFault Connected(CURLcode code)
{
    TCurlFault fault = Fault(code);
    fault.isConnected = true;
    return fault;
}

TCurlFault Begun(CURLcode code)
{
    TCurlFault fault = Fault(code);
    fault.hasAnswerBegun = true;
    return fault;
}

void ExpectFaults(const std::vector<TCurlFaultRow>& rows)
{
    for (const TCurlFaultRow& row : rows) {
        TCurlTransport::TSettings settings;
        settings.address = ReadWbemAddress(row.address);
        const TWbemFault fault = DescribeCurlFault(row.fault, settings);
        EXPECT_EQ(settings.address.server + ": " + row.message, fault.what()) << row.what;
        EXPECT_EQ(row.kind, fault.GetKind()) << row.what;
    }
}

TEST(CurlFaultTest, AFaultOfAConnectionSaysWhatToDo)
{
    ExpectFaults({
        {"name", "https://array1", Fault(CURLE_COULDNT_RESOLVE_HOST), TWbemFault::kFinal,
         "no address is known for array1; correct the name, or name the address itself"},
        {"proxy", "https://array1", Fault(CURLE_COULDNT_RESOLVE_PROXY), TWbemFault::kFinal,
         "no address is known for the proxy; correct https_proxy or http_proxy"},
        {"refused", "https://array1", Connection(ECONNREFUSED), TWbemFault::kUnreachable,
         "no connection: Connection refused; is the server running, and is that its port?"},
        {"no reason", "https://array1", Connection(0), TWbemFault::kUnreachable,
         "no connection: curl's words; is the server running, and is that its port?"},
        {"no TLS", "https://array1", Fault(CURLE_SSL_CONNECT_ERROR, "wrong version number"), TWbemFault::kFinal,
         "no TLS connection: wrong version number; if the server does not speak TLS at that port, ask it as http:// or at another "
         "port"},
        {"no connection in time", "https://array1", Fault(CURLE_OPERATION_TIMEDOUT), TWbemFault::kFinal,
         "no connection within 20 s; is the server running, and is that its port?"},
        {"silent", "https://array1", Connected(CURLE_OPERATION_TIMEDOUT), TWbemFault::kSilent,
         "the server was silent for 120 s; allow it more with --timeout SECONDS"},
    });
}

TEST(CurlFaultTest, AFaultOfACertificateSaysWhatToDo)
{
    ExpectFaults({
        {"other host", "https://array1", Certificate(0, "DNS:array2"), TWbemFault::kFinal,
         "found the certificate of another host (DNS:array2), expected one for array1; ask for the server by a name that is in its"
         " certificate"},
        {"expired", "https://array1", Certificate(10), TWbemFault::kFinal,
         "found a certificate that has expired; let the server have a new one, or set the clock of this machine"},
        {"too new", "https://array1", Certificate(9), TWbemFault::kFinal,
         "found a certificate that is not valid yet; let the server have a new one, or set the clock of this machine"},
        {"unknown", "https://array1", Certificate(20), TWbemFault::kFinal,
         "found a certificate of an authority that is not known here; give the authority's certificate, or the server's own if it "
         "is"
         " self-signed, with --ca FILE"},
    });
}

TEST(CurlFaultTest, AFaultOfAnAnswerSaysWhatToDo)
{
    ExpectFaults({
        {"no answer", "https://array1", Fault(CURLE_GOT_NOTHING), TWbemFault::kBroken,
         "the connection was closed without an answer"},
        {"no answer without TLS", "http://array1", Fault(CURLE_GOT_NOTHING), TWbemFault::kBroken,
         "the connection was closed without an answer; if the server speaks TLS there, ask it as https://"},
        {"cut", "https://array1", Begun(CURLE_PARTIAL_FILE), TWbemFault::kBroken,
         "the connection ended in the middle of an answer"},
        {"no HTTP", "http://array1", Fault(CURLE_UNSUPPORTED_PROTOCOL), TWbemFault::kFinal,
         "found an answer that is not HTTP; is this the port of a WBEM server?"},
        {"anything else", "http://array1", Fault(CURLE_FILESIZE_EXCEEDED), TWbemFault::kAnswer, "curl's words"},
    });
}

TEST(CurlFaultTest, AFileOfAuthoritiesIsNamed)
{
    TCurlTransport::TSettings settings;
    settings.address = ReadWbemAddress("https://array1");
    settings.caFile = "ca.pem";
    EXPECT_STREQ(
        "https://array1:5989: found a certificate that no authority in ca.pem has signed; give the certificate of the right one"
        " with --ca FILE",
        DescribeCurlFault(Certificate(20), settings).what());
    EXPECT_STREQ("ca.pem: found no certificate there, expected those of authorities in PEM; correct --ca",
                 DescribeCurlFault(Fault(CURLE_SSL_CACERT_BADFILE), settings).what());
}

}  // namespace
}  // namespace NORVZEL20

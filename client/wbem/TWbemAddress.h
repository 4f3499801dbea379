#pragma once

#include <string>

namespace NORVZEL20 {

/// Where a WBEM server is asked. A plain value.
struct TWbemAddress {
    std::string url;          ///< of the requests, with port and path
    std::string server;       ///< what messages call the server: "https://array1:5989"
    std::string host;         ///< without the brackets of an IPv6 address
    bool isSecure = false;    ///< https
    bool isLoopback = false;  ///< requests do not leave this machine
};

/// Reads `http[s]://HOST[:PORT][/PATH]`. Without a port it is 5988 (http) or 5989 (https), without a path /cimom.
/// Errors: TClientError for anything else. The message never shows a user name or a password.
TWbemAddress ReadWbemAddress(const std::string& text);

/// The name of a namespace without slashes in front and behind. Errors: TClientError if a part of it is empty.
std::string ReadNamespaceName(const std::string& text);

}  // namespace NORVZEL20

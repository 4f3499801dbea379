#pragma once

#include <string>

#include "client/wbem/TCurlTransport.h"
#include "client/wbem/TWbemFault.h"

namespace NORVZEL20 {

/// What libcurl says about a request that failed. A plain value.
struct TCurlFault {
    int code = 0;                  ///< CURLcode
    std::string words;             ///< curl's own
    long systemError = 0;          ///< errno of the connection; 0 for none
    long certificateError = 0;     ///< of OpenSSL's check of the certificate; 0 for none
    std::string certificateNames;  ///< whose certificate the server showed; empty if that is not known
    bool isConnected = false;      ///< with TLS, if the address asks for it
    bool hasAnswerBegun = false;
};

/// The same as a fault whose message says what can be done.
TWbemFault DescribeCurlFault(const TCurlFault& fault, const TCurlTransport::TSettings& settings);

}  // namespace NORVZEL20

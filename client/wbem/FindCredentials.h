#pragma once

#include <functional>
#include <string>

#include "client/wbem/TCurlTransport.h"
#include "client/wbem/TWbemServer.h"

namespace NORVZEL20 {

/// Where user and password come from.
struct TCredentialsChoice {
    bool hasNetrc = false;
    std::string netrcFile;             ///< empty: ~/.netrc
    bool mayPassInTheOpen = false;     ///< whether a password may go over http to another machine
    std::function<void()> onAsking;    ///< called before the person is asked
    std::function<void()> onAnswered;  ///< and after that
};

/// Fills in who asks the server: a file of netrc if it is chosen; otherwise CIMDELTA_USER and CIMDELTA_PASSWORD; and for what these
/// lack, the person at the terminal, if there is one and the server wants a user.
/// Errors: TClientError if the file cannot be read, a password comes without a user, or a password would go over http to another
/// machine and may not. Asking the person throws the last one too.
void FindCredentials(const TCredentialsChoice& choice, TCurlTransport::TSettings& transport, TWbemServer::TSettings& server);

}  // namespace NORVZEL20

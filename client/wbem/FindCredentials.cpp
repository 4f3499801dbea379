#include "client/wbem/FindCredentials.h"

#include <unistd.h>

#include <cstdlib>

#include "client/process/AskOnTerminal.h"
#include "client/process/SystemError.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

const char kUser[] = "CIMDELTA_USER";
const char kPassword[] = "CIMDELTA_PASSWORD";

std::string VariableOf(const char* name)
{
    const char* value = std::getenv(name);
    return value == nullptr ? std::string() : value;
}

// Everybody on the way could read the password.
void RequirePrivacy(const TCredentialsChoice& choice, const TWbemAddress& address)
{
    if (!address.isSecure && !address.isLoopback && !choice.mayPassInTheOpen) {
        throw TClientError(EscapeForDisplay(address.server) +
                           ": the password would go over the network unencrypted; ask the server as https://, or allow it with"
                           " --password-over-http");
    }
}

void TakeNetrc(const TCredentialsChoice& choice, TCurlTransport::TSettings& transport, TWbemServer::TSettings& server)
{
    const std::string path = choice.netrcFile.empty() ? VariableOf("HOME") + "/.netrc" : choice.netrcFile;
    if (access(path.c_str(), R_OK) != 0) {
        throw TClientError(EscapeForDisplay(path) + " cannot be read", LastSystemError(),
                           "; --netrc names a file with user and password of the server");
    }
    transport.hasNetrc = true;
    transport.netrcFile = path;
    server.credentialsOrigin = path;
}

// The terminal is the person's meanwhile.
class TWhileAsking {
  public:
    explicit TWhileAsking(const TCredentialsChoice& choice) : fChoice(choice)
    {
        if (fChoice.onAsking) {
            fChoice.onAsking();
        }
    }
    TWhileAsking(const TWhileAsking&) = delete;
    TWhileAsking& operator=(const TWhileAsking&) = delete;
    ~TWhileAsking()
    {
        if (fChoice.onAnswered) {
            fChoice.onAnswered();
        }
    }

  private:
    const TCredentialsChoice& fChoice;
};

// What is known comes first, so a person types only the rest.
std::optional<TWbemCredentials> AskPerson(const TCredentialsChoice& choice, const TWbemAddress& address,
                                          const TWbemCredentials& known)
{
    if (!HasTerminal()) {
        return std::nullopt;
    }
    RequirePrivacy(choice, address);
    const TWhileAsking asking(choice);
    std::optional<std::string> user = known.user;
    if (known.user.empty()) {
        user = AskOnTerminal("User name for " + EscapeForDisplay(address.server) + ": ", false);
    }
    const std::optional<std::string> password =
        user && !user->empty() ? AskOnTerminal("Password of " + EscapeForDisplay(*user) + ": ", true) : std::nullopt;
    return password ? std::optional<TWbemCredentials>({*user, *password}) : std::nullopt;
}

}  // namespace

void FindCredentials(const TCredentialsChoice& choice, TCurlTransport::TSettings& transport, TWbemServer::TSettings& server)
{
    const TWbemAddress& address = server.address;
    if (choice.hasNetrc) {
        RequirePrivacy(choice, address);
        return TakeNetrc(choice, transport, server);
    }
    server.credentials.user = VariableOf(kUser);
    server.credentials.password = VariableOf(kPassword);
    if (server.credentials.user.empty()) {
        if (!server.credentials.password.empty()) {
            throw TClientError(std::string(kPassword) + " is set, and " + kUser + " is not; set both or none");
        }
    } else {
        RequirePrivacy(choice, address);
        server.credentialsOrigin = std::string(kUser) + " and " + kPassword;
    }
    if (server.credentials.user.empty() || std::getenv(kPassword) == nullptr) {
        server.askPerson = [choice, address](const TWbemCredentials& known) { return AskPerson(choice, address, known); };
    }
}

}  // namespace NORVZEL20

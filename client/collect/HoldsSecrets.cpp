#include "client/collect/HoldsSecrets.h"

#include <fnmatch.h>

#include <algorithm>
#include <iterator>

namespace NORVZEL20 {

namespace {

// Shell patterns of whole paths; an asterisk also stands for slashes.
constexpr const char* kSecretFiles[] = {
    "*/shadow",
    "*/shadow-",
    "*/gshadow",
    "*/gshadow-",
    "*/opasswd",
    "*.key",
    "*_key",
    "*/id_rsa",
    "*/id_ecdsa",
    "*/id_ed25519",
    "*/id_dsa",
    "*.p12",
    "*.pfx",
    "*.jks",
    "*.keystore",
    "*.keytab",
    "*.kdbx",
    "*.psk",
    "*.ovpn",
    "*/private/*",
    "*secret*",
    "*password*",
    "*htpasswd*",
    "*htdigest*",
    "*/passwd.client",
    "*/sasl_passwd*",
    "*/sasldb2",
    "*netrc",
    "*authinfo*",
    "/etc/apt/auth.conf*",
    "*/.pgpass",
    "*/.my.cnf",
    "*/debian.cnf",
    "*/rndc.key*",
    "*credentials*",
    "/etc/wireguard/*.conf",
    "/etc/NetworkManager/system-connections/*",
    "/etc/wpa_supplicant/*.conf",
    "/etc/ppp/chap*",
    "/etc/ppp/pap*",
};

// Files about passwords that hold none.
constexpr const char* kOpenFiles[] = {"/etc/pam.d/*"};

bool Matches(const char* const* begin, const char* const* end, const std::string& path)
{
    return std::any_of(begin, end, [&path](const char* pattern) { return fnmatch(pattern, path.c_str(), 0) == 0; });
}

}  // namespace

bool HoldsSecrets(const std::string& path)
{
    return Matches(std::begin(kSecretFiles), std::end(kSecretFiles), path) &&
           !Matches(std::begin(kOpenFiles), std::end(kOpenFiles), path);
}

}  // namespace NORVZEL20

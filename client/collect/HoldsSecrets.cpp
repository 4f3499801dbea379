#include "client/collect/HoldsSecrets.h"

#include "client/collect/MatchesAny.h"

namespace NORVZEL20 {

namespace {

// Patterns of whole paths, as MatchesAny takes them.
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

}  // namespace

bool HoldsSecrets(const std::string& path)
{
    return MatchesAny(path, kSecretFiles) && !MatchesAny(path, kOpenFiles);
}

}  // namespace NORVZEL20

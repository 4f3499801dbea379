#pragma once

#include <string>

#include "client/collect/TSystemRoot.h"

namespace NORVZEL20 {

/// The digest of an ordinary file, "sha256:" with hexadecimal digits. Empty, with the reason in `trouble`, if the file cannot be
/// read, is larger than TSystemRoot::kMostBytes, changes while it is read, or holds a private key or a
/// shared one, in words or in DER.
std::string DigestFile(const TSystemRoot& root, const std::string& path, std::string& trouble);

/// The reason if a file is for keys or passwords.
inline constexpr char kSecretReason[] = "it may hold keys or passwords";

}  // namespace NORVZEL20

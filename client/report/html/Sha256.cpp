#include "client/report/html/Sha256.h"

#include <openssl/evp.h>

#include <boost/algorithm/hex.hpp>
#include <new>

namespace NORVZEL20 {

std::string Sha256(std::string_view text)
{
    constexpr std::size_t kLength = 32;
    std::string digest(kLength, '\0');
    if (EVP_Digest(text.data(), text.size(), reinterpret_cast<unsigned char*>(digest.data()), nullptr, EVP_sha256(), nullptr) !=
        1) {
        throw std::bad_alloc();  // nothing else can go wrong
    }
    return digest;
}

std::string Sha256Hex(std::string_view text)
{
    return boost::algorithm::hex_lower(Sha256(text));
}

}  // namespace NORVZEL20

#include "client/report/html/Base64.h"

#include <openssl/evp.h>

#include <cstddef>

namespace NORVZEL20 {

std::string EncodeBase64(std::string_view bytes)
{
    // The library ends its text with a NUL.
    std::string text((bytes.size() + 2) / 3 * 4 + 1, '\0');
    EVP_EncodeBlock(reinterpret_cast<unsigned char*>(text.data()), reinterpret_cast<const unsigned char*>(bytes.data()),
                    static_cast<int>(bytes.size()));
    text.pop_back();
    return text;
}

}  // namespace NORVZEL20

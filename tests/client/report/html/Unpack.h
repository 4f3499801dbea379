#pragma once

#include <zlib.h>

#include <stdexcept>
#include <string>
#include <string_view>

namespace NORVZEL20 {

/// The bytes of a base64 text; line ends in it do not count.
inline std::string DecodeBase64(std::string_view text)
{
    static const std::string kDigits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string bytes;
    unsigned bits = 0;
    unsigned count = 0;
    for (const char digit : text) {
        const std::size_t value = kDigits.find(digit);
        if (value == std::string::npos) {
            continue;
        }
        bits = bits << 6U | static_cast<unsigned>(value);
        count += 6;
        if (count >= 8) {
            count -= 8;
            bytes += static_cast<char>(bits >> count & 0xFFU);
        }
    }
    return bytes;
}

/// What TPackedText packed. Errors: std::runtime_error if it is damaged.
inline std::string Unpack(std::string_view packed)
{
    std::string bytes = DecodeBase64(packed);
    std::string text;
    z_stream stream = {};
    inflateInit2(&stream, 15 + 16);
    stream.next_in = reinterpret_cast<Bytef*>(&bytes[0]);
    stream.avail_in = static_cast<uInt>(bytes.size());
    int status = Z_OK;
    while (status == Z_OK) {
        char buffer[65536];
        stream.next_out = reinterpret_cast<Bytef*>(buffer);
        stream.avail_out = sizeof buffer;
        status = inflate(&stream, Z_NO_FLUSH);
        text.append(buffer, sizeof buffer - stream.avail_out);
    }
    inflateEnd(&stream);
    if (status != Z_STREAM_END) {
        throw std::runtime_error("damaged");
    }
    return text;
}

}  // namespace NORVZEL20

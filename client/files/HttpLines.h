#pragma once

#include <cstddef>
#include <string_view>

namespace NORVZEL20 {

/// What the lines of a message of HTTP (RFC 9112) are. Each works on a line without its end. Errors: none.

/// The length of a header's name (a token of RFC 9110, 5.6.2) at the beginning of a line; 0 if there is none.
std::size_t FindHeaderName(std::string_view line);

/// Whether a message that begins with this line begins with a header: one with a name as the headers of CIM have.
bool IsFirstHeader(std::string_view line);

/// Whether it is the first line of a request that CIM clients send.
bool IsRequestLine(std::string_view line);

/// The digits at the beginning of a line that is the length of a chunk, at most kMostDigitsOfLength; empty if it is not.
std::string_view FindChunkLength(std::string_view line);

/// Whether a file that begins so is a recorded message of HTTP. Empty lines in front of it, and a byte order mark, do not matter.
/// `file` needs its first line and the first byte of the next, behind them.
bool IsHttp(std::string_view file);

inline constexpr std::size_t kMostDigitsOfLength = 15;
inline constexpr std::string_view kByteOrderMark = "\xef\xbb\xbf";

}  // namespace NORVZEL20

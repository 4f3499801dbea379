#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// How many first bytes of a file RecognizeCompression needs.
inline constexpr std::size_t kCompressionMark = 6;

/// The first bytes of xz data.
inline constexpr std::string_view kXzMagic{"\xfd\x37zXZ\x00", kCompressionMark};

/// What a file is compressed with, by its first bytes: "gzip", "xz", "zstd", "bzip2", "lz4", "zip" or "lzip"; empty if with none of
/// these.
std::string RecognizeCompression(std::string_view begin);

/// A reason of FailDamaged.
inline constexpr char kSomethingFollows[] = "something else follows it";

/// Throws TClientError: the file `name`, compressed with `kind`, is damaged for that reason.
[[noreturn]] void FailDamaged(const std::string& name, const std::string& kind, const std::string& reason);

/// Throws TClientError: there is no memory to decompress the file `name`.
[[noreturn]] void FailForMemory(const std::string& name);

}  // namespace NORVZEL20

#pragma once

#include <boost/function.hpp>
#include <exception>
#include <memory>
#include <string>
#include <string_view>

struct archive;

namespace NORVZEL20 {

/// What a file of that name is to be compressed with: "gzip" for .gz, "xz" for .xz, "zstd" for .zst, in any letter case; empty
/// otherwise. Errors: TClientError if the name asks for a compression that cannot be written.
std::string CompressionOfName(const std::string& path);

/// Compresses a text, piece by piece. Memory: at most some 40 MiB.
class TCompressor {
  public:
    /// Takes the compressed bytes. It may throw; the operation that called it throws that on.
    using TSink = boost::function<void(std::string_view piece)>;

    /// `kind` is one of CompressionOfName. Errors: TClientError if the library for it is missing; std::bad_alloc; those of the
    /// sink.
    TCompressor(const std::string& kind, TSink sink);
    TCompressor(const TCompressor&) = delete;
    TCompressor& operator=(const TCompressor&) = delete;
    /// Without End, the sink gets no more bytes, and what it got is no whole file.
    ~TCompressor();

    void Write(std::string_view piece);
    /// Hands on what is left. Call this once, after the last piece.
    void End();

  private:
    static long Take(archive* writer, void* self, const void* bytes, std::size_t size);
    void Require(bool isGood) const;

    TSink fSink;
    std::exception_ptr fFault;  // of the sink
    bool fIsOver = false;       // the sink gets nothing more
    std::unique_ptr<archive, int (*)(archive*)> fArchive;
};

}  // namespace NORVZEL20

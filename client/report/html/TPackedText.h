#pragma once

#include <zlib.h>

#include <string>
#include <string_view>

#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// Bytes on their way into a page: compressed with gzip, and written in base64, in lines. The same bytes give the same text.
class TPackedText {
  public:
    /// Errors: std::bad_alloc.
    explicit TPackedText(const TTextSink& sink);
    TPackedText(const TPackedText&) = delete;
    TPackedText& operator=(const TPackedText&) = delete;
    ~TPackedText();

    /// Takes the next bytes. Errors: what the sink throws; std::bad_alloc.
    void Add(std::string_view bytes);
    /// Writes what is left. Call it once, at the end. Errors: as for Add.
    void End();

  private:
    void Compress(std::string_view bytes, int flush);
    void WriteLine();

    const TTextSink& fSink;
    z_stream fStream = {};
    std::string fLine;  // compressed bytes that make one line of text
    std::size_t fFilled = 0;
};

}  // namespace NORVZEL20

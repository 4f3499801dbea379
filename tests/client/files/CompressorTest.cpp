// Compressed bytes that cannot be taken: the caller gets the sink's own exception, and the sink gets nothing more.
#include "client/files/TCompressor.h"

#include <gtest/gtest.h>

#include <random>

namespace NORVZEL20 {
namespace {

struct TNoRoom {
    int call;
};

/// A text that hardly gets shorter.
std::string Noise(std::size_t size)
{
    std::mt19937 random(1);
    std::string text(size, ' ');
    for (char& c : text) {
        c = static_cast<char>(random());
    }
    return text;
}

/// Compresses the text in pieces into a sink that throws at its `last`-th call, which is counted from 1.
class TFailingSink {
  public:
    explicit TFailingSink(int last) : fLast(last) {}

    /// Returns whether the exception of the sink arrived.
    bool Compress(const std::string& kind, const std::string& text)
    {
        try {
            TCompressor compressor(kind, [this](std::string_view) { Take(); });
            constexpr std::size_t kPiece = 10000;
            for (std::size_t at = 0; at < text.size(); at += kPiece) {
                compressor.Write(std::string_view(text).substr(at, kPiece));
            }
            compressor.End();
            return false;
        } catch (const TNoRoom& fault) {
            EXPECT_EQ(fLast, fault.call);
            return true;
        }
    }

    int GetCalls() const { return fCalls; }

  private:
    void Take()
    {
        if (++fCalls >= fLast) {
            throw TNoRoom{fCalls};
        }
    }

    const int fLast;
    int fCalls = 0;
};

TEST(CompressorTest, FaultOfTheSinkArrivesAndEndsIt)
{
    const std::string text = Noise(300000);
    for (const char* const kind : {"gzip", "xz", "zstd"}) {
        int last = 1;
        for (bool hasFailed = true; hasFailed; ++last) {
            SCOPED_TRACE(kind + std::to_string(last));
            TFailingSink sink(last);
            hasFailed = sink.Compress(kind, text);
            EXPECT_EQ(hasFailed ? last : last - 1, sink.GetCalls());
        }
        EXPECT_LT(3, last) << kind;
    }
}

}  // namespace
}  // namespace NORVZEL20

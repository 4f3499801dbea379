// Reads recorded answers of HTTP: whole, byte by byte and in small pieces, into large and small buffers. All of them give the same
// text, or the same message. The text is not longer than the bytes: what replaces a part of them is no longer than that part.

#include <algorithm>

#include "client/files/THttpReader.h"
#include "client/process/TClientError.h"
#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

namespace {

/// Bytes that come in pieces of a certain size.
class TPieces : public IByteSource {
  public:
    TPieces(std::string_view bytes, std::size_t piece) : fBytes(bytes), fPiece(piece) {}

    std::size_t Read(char* buffer, std::size_t size) override
    {
        const std::size_t length = std::min({size, fPiece, fBytes.size()});
        std::copy_n(fBytes.begin(), length, buffer);
        fBytes.remove_prefix(length);
        return length;
    }

  private:
    std::string_view fBytes;
    const std::size_t fPiece;
};

/// The text, or the message after what was read until then.
std::string ReadHttp(std::string_view input, std::size_t piece, std::size_t room)
{
    TPieces source(input, piece);
    std::string text;
    try {
        THttpReader reader(source, "fuzz.http");
        std::string buffer(room, '\0');
        while (const std::size_t length = reader.Read(&buffer[0], room)) {
            Promise(length <= room, "no more is read than there is room for");
            text.append(buffer, 0, length);
            Promise(text.size() <= input.size(), "the text is not longer than the answers");
        }
    } catch (const TClientError& error) {
        const std::string message = error.what();
        Promise(message.rfind("fuzz.http", 0) == 0, "an error names the file", message);
        return text + "\nerror: " + message;
    }
    return text;
}

}  // namespace

void FuzzHttp(std::string_view input)
{
    constexpr std::size_t kWhole = 1 << 20;
    const std::string whole = ReadHttp(input, kWhole, kWhole);
    for (const auto& [piece, room] : {std::pair<std::size_t, std::size_t>{1, kWhole}, {7, 5}, {kWhole, 1}}) {
        PromiseEqual(whole, ReadHttp(input, piece, room), "pieces do not matter");
    }
}

}  // namespace NORVZEL20

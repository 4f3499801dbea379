#include "embedded/cimxml/TXmlWindow.h"

#include <cstring>

#include "embedded/cimxml/TXmlSearch.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

/// Moves the place over the bytes from `from` to `to`, which are valid UTF-8. `to` must not be between the two bytes of a line
/// end. The byte at `to` is read.
void Advance(TTextPlace& place, const char* from, const char* to) noexcept
{
    const std::size_t lines = TXmlSearch::CountLineEnds(from, to);
    const char* lineBegin = from;
    if (lines > 0) {
        place.line += lines;
        place.column = 1;
        for (lineBegin = to; lineBegin[-1] != '\n' && lineBegin[-1] != '\r'; --lineBegin) {
        }
    }
    for (; lineBegin < to; ++lineBegin) {
        place.column += TUtf8::IsContinuation(*lineBegin) ? 0 : 1;
    }
}

}  // namespace

static_assert(TXmlWindow::kPad > TXmlSearch::kReadsBeyond, "a search stays in the buffer");

void TXmlWindow::Reset(const TTextPlace& place) noexcept
{
    fBegin = fEnd = fBuffer.get();
    fCounted = fBegin;
    fPlace = place;
}

/// If little is left, it moves to the front. Otherwise the new buffer is large enough that as much can come before the next move.
char* TXmlWindow::GetRoom(std::size_t length)
{
    constexpr std::size_t kSpare = 4096;
    const std::size_t kept = GetLength();
    const auto done = static_cast<std::size_t>(fBegin - fBuffer.get());
    if (fBuffer && done + kept + length + kPad <= fCapacity) {
        return fEnd;
    }
    fPlace = GetPlace(fBegin);
    if (kept + length + kPad <= fCapacity && kept <= done) {
        std::memcpy(fBuffer.get(), fBegin, kept);
    } else {
        const std::size_t capacity = 2 * kept + length + kPad + kSpare;
        std::unique_ptr<char[]> buffer(new char[capacity]);
        if (kept > 0) {
            std::memcpy(buffer.get(), fBegin, kept);
        }
        fBuffer = std::move(buffer);
        fCapacity = capacity;
    }
    fBegin = fBuffer.get();
    fEnd = fBegin + kept;
    fCounted = fBegin;
    return fEnd;
}

void TXmlWindow::Add(std::size_t length) noexcept
{
    fEnd += length;
    std::memset(fEnd, 0, kPad);
}

TTextPlace TXmlWindow::GetPlace(const char* at) noexcept
{
    if (at > fCounted) {
        Advance(fPlace, fCounted, at);
        fCounted = at;
    }
    return fPlace;
}

}  // namespace NORVZEL20

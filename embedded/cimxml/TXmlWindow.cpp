#include "embedded/cimxml/TXmlWindow.h"

#include <cstring>

#include "embedded/cimxml/TXmlSearch.h"

namespace NORVZEL20 {

static_assert(TXmlWindow::kPad > TXmlSearch::kReadsBeyond, "a search stays in the buffer");

void TXmlWindow::Reset() noexcept
{
    fBegin = fEnd = fBuffer.get();
    fCounted = fBegin;
    fPlace = TXmlPlace();
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

TXmlPlace TXmlWindow::GetPlace(const char* at) noexcept
{
    if (at > fCounted) {
        fPlace.Advance(fCounted, at);
        fCounted = at;
    }
    return fPlace;
}

}  // namespace NORVZEL20

#include "embedded/value/TTextRun.h"

#include <cstring>
#include <new>

namespace NORVZEL20 {

TTextRun::TPointer TTextRun::Create(std::size_t size)
{
    return TPointer(new (::operator new(size)) TTextRun(size), false);
}

void TTextRun::Drop(const TTextRun* run) noexcept
{
    if (run->Release()) {
        run->~TTextRun();
        ::operator delete(const_cast<TTextRun*>(run));
    }
}

bool TTextRun::HasRoomFor(std::size_t length) const noexcept
{
    return sizeof(TTextRun) + fUsed + length <= fSize;
}

std::uint16_t TTextRun::Append(std::string_view text) noexcept
{
    const std::uint16_t offset = fUsed;
    std::memcpy(reinterpret_cast<char*>(this + 1) + offset, text.data(), text.size());
    fUsed = static_cast<std::uint16_t>(fUsed + text.size());
    return offset;
}

}  // namespace NORVZEL20

#include "embedded/value/TTextRun.h"

#include <cstring>
#include <new>

namespace NORVZEL20 {

TTextRun::TPointer TTextRun::Create()
{
    return TPointer(new (::operator new(kSize)) TTextRun, false);
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
    return sizeof(TTextRun) + fUsed + length <= kSize;
}

std::uint16_t TTextRun::Append(std::string_view text) noexcept
{
    const auto offset = static_cast<std::uint16_t>(fUsed);
    std::memcpy(reinterpret_cast<char*>(this + 1) + offset, text.data(), text.size());
    fUsed += static_cast<std::uint32_t>(text.size());
    return offset;
}

}  // namespace NORVZEL20

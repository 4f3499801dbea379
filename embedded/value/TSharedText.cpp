#include "embedded/value/TSharedText.h"

#include <cstring>
#include <limits>
#include <new>

namespace NORVZEL20 {

const TSharedText* TSharedText::CreateRaw(std::string_view text)
{
    if (text.size() > std::numeric_limits<std::uint32_t>::max()) {
        throw std::bad_alloc();
    }
    // The characters follow the object in the same block.
    void* memory = ::operator new(sizeof(TSharedText) + text.size());
    TSharedText* block = new (memory) TSharedText(static_cast<std::uint32_t>(text.size()));
    if (!text.empty()) {
        std::memcpy(static_cast<void*>(block + 1), text.data(), text.size());
    }
    return block;
}

TSharedText::TPointer TSharedText::Create(std::string_view text)
{
    return TPointer(CreateRaw(text), false);
}

void TSharedText::Drop(const TSharedText* text) noexcept
{
    if (text->Release()) {
        text->~TSharedText();
        ::operator delete(const_cast<TSharedText*>(text));
    }
}

}  // namespace NORVZEL20

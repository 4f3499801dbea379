// The bytes of a value (TCIMValue.cpp draws their layout). Everything here relies on the form, which the caller has checked, and
// only ShareFrame throws: a caller makes a block before it stores the pointer.

#include "embedded/value/TValueAccess.h"

#include <algorithm>
#include <new>

#include "embedded/value/TCountedBlocks.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TReferenceContents.h"

namespace NORVZEL20 {

namespace {

template <class TBlock>
void DropUse(const TBlock* block) noexcept
{
    if (block->Release()) {
        delete block;
    }
}

}  // namespace

static_assert(sizeof(TCIMValue) == 16, "values are laid out inline in instances by the million");
static_assert(sizeof(TCIMReference) == sizeof(void*), "a path value holds the path itself in the place of its pointer");

TCIMValue TValueAccess::FromSharedText(const TSharedText::TPointer& text) noexcept
{
    // Short text is copied into the value, which then needs no use of the block.
    if (text->GetText().size() <= kShortTextSize) {
        TCIMValue value(TCIMValue::TCIMType::kString, kShortText);
        StoreText(value, text->GetText());
        return value;
    }
    TCIMValue value(TCIMValue::TCIMType::kString, kSharedText);
    text->Acquire();
    Store(value, static_cast<const TCounted*>(text.get()));
    return value;
}

TCIMValue TValueAccess::FromRun(const TTextRun& run, std::uint16_t offset, std::uint16_t length) noexcept
{
    TCIMValue value(TCIMValue::TCIMType::kString, kRunText);
    run.Acquire();
    Store(value, length, kRunLength);
    Store(value, offset, kRunOffset);
    Store(value, static_cast<const TCounted*>(&run));
    return value;
}

std::string_view TValueAccess::GetText(const TCIMValue& value) noexcept
{
    if (value.fForm == kShortText) {
        return {reinterpret_cast<const char*>(value.fBytes + 1), value.fBytes[0]};
    }
    if (value.fForm == kRunText) {
        const auto* const run = static_cast<const TTextRun*>(GetBlock(value));
        return run->GetText(Load<std::uint16_t>(value, kRunOffset), Load<std::uint16_t>(value, kRunLength));
    }
    return static_cast<const TSharedText*>(GetBlock(value))->GetText();
}

bool TValueAccess::IsIndistinguishable(const TCIMValue& a, const TCIMValue& b) noexcept
{
    if (HasSameBytes(a, b)) {
        return true;
    }
    if (a.fType != b.fType) {
        return false;
    }
    if (IsText(a) && IsText(b)) {
        return GetText(a) == GetText(b);
    }
    if (a.fForm != b.fForm) {
        return false;
    }
    if (a.fForm == kArray || a.fForm == kBag) {
        const auto& left = static_cast<const TCountedArray*>(GetBlock(a))->elements;
        const auto& right = static_cast<const TCountedArray*>(GetBlock(b))->elements;
        return std::equal(left.begin(), left.end(), right.begin(), right.end(), &IsIndistinguishable);
    }
    if (a.fForm == kPath) {
        const TCIMReference::TContents* const left = GetPath(a).fContents;
        const TCIMReference::TContents* const right = GetPath(b).fContents;
        return left != nullptr && right != nullptr && left->IsIndistinguishable(*right);
    }
    return false;
}

bool TValueAccess::HasSameFrame(const TCIMValue& a, const TCIMValue& b) noexcept
{
    if (a.fForm != kPath || b.fForm != kPath) {
        return false;
    }
    const TCIMReference::TContents* const left = GetPath(a).fContents;
    const TCIMReference::TContents* const right = GetPath(b).fContents;
    return left != nullptr && right != nullptr && left->bindings.HasSameFrame(right->bindings);
}

void TValueAccess::ShareFrame(TCIMValue& value, const TCIMValue& other)
{
    // The value is not const, and so the path in it is not either.
    TCIMReference& path = const_cast<TCIMReference&>(GetPath(value));
    path.Own().bindings.ShareFrame(GetPath(other).fContents->bindings);
}

TCIMValue TValueAccess::FromBits(TCIMValue::TCIMType type, std::uint64_t bits) noexcept
{
    TCIMValue value(type, kNumber);
    Store(value, bits);
    return value;
}

TCIMValue TValueAccess::FromReal(TCIMValue::TCIMType type, double number) noexcept
{
    TCIMValue value(type, kNumber);
    Store(value, number);
    return value;
}

// A path is nothing but a pointer to its contents, so the value's pointer can be read as a path.
const TCIMReference& TValueAccess::GetPath(const TCIMValue& value) noexcept
{
    return *std::launder(reinterpret_cast<const TCIMReference*>(value.fBytes + kPayload));
}

void TValueAccess::StoreText(TCIMValue& value, std::string_view text) noexcept
{
    value.fBytes[0] = static_cast<unsigned char>(text.size());
    if (!text.empty()) {
        // The data of an empty view may be a null pointer, which memcpy does not accept.
        std::memcpy(value.fBytes + 1, text.data(), text.size());
    }
}

void TValueAccess::StoreDateTime(TCIMValue& value, const TCIMDateTime& time) noexcept
{
    // The last arguments are positions in fBytes.
    Store(value, time.fMicroseconds);
    Store(value, time.fOffset, 0);
    Store(value, time.fUnknown, 2);
    Store(value, static_cast<unsigned char>(time.fInterval), 4);
}

TCIMDateTime TValueAccess::LoadDateTime(const TCIMValue& value) noexcept
{
    TCIMDateTime time;
    time.fMicroseconds = Load<std::int64_t>(value);
    time.fOffset = Load<std::int16_t>(value, 0);
    time.fUnknown = Load<std::uint16_t>(value, 2);
    time.fInterval = Load<unsigned char>(value, 4) != 0;
    return time;
}

const TCounted* TValueAccess::AcquirePath(const TCIMReference& path) noexcept
{
    if (path.fContents != nullptr) {
        path.fContents->Acquire();
    }
    return path.fContents;
}

void TValueAccess::LimitDepth(TCIMValue& key, unsigned int above)
{
    if (TCIMReference::TContents::GetDepth(key) + above <= TCIMReference::TContents::kMaxDepth) {
        return;
    }
    if (GetForm(key) == kPath) {
        key = TCIMValue(GetPath(key).GetPath());
    } else if (GetForm(key) == kObject) {
        key = TCIMValue(key.GetEmbeddedObject()->GetKeyText());
    }
}

void TValueAccess::FreeSparePaths() noexcept
{
    TCIMReference::TContents::FreeSpares();
}

// TCounted is not polymorphic: the form says which block it is.
void TValueAccess::DropBlock(const TCIMValue& value) noexcept
{
    const TCounted* const block = GetBlock(value);
    switch (value.fForm) {
    case kSharedText:
        TSharedText::Drop(static_cast<const TSharedText*>(block));
        break;
    case kRunText:
        TTextRun::Drop(static_cast<const TTextRun*>(block));
        break;
    case kObject:
        DropUse(static_cast<const TCountedObject*>(block));
        break;
    case kPath:
        // The empty path has no contents. Who uses contents alone may change them, as the path did that made them.
        if (block != nullptr) {
            TCIMReference::TContents::Drop(
                const_cast<TCIMReference::TContents*>(static_cast<const TCIMReference::TContents*>(block)));
        }
        break;
    default:
        DropUse(static_cast<const TCountedArray*>(block));
        break;
    }
}

}  // namespace NORVZEL20

// Sharing texts that repeat.
//
// Inventories repeat themselves: the same class names, vendors and states stand in thousands of instances. Values can share a text
// by reference count, so the pool keeps texts to share, in a table of fixed size: the hash of a text selects a bucket, and a bucket
// keeps one text.
//
// The first time a text comes, the bucket only notes its hash. If the next text in that bucket has the same hash, it is taken as
// repeating and kept, in place of the one before. So texts that are all different cost a hash and their characters in a run, and
// texts that repeat are not pushed out by a single other one. Longer text hardly ever repeats and has a block of its own. Two texts
// with the same hash do no harm: the text itself is compared.
#include "embedded/load/TTextPool.h"

#include <cstdint>
#include <cstring>
#include <utility>

#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kFactor = 0x9e3779b97f4a7c15u;

/// Mixes eight bytes at a time; the last eight overlap those before. The text must have at least eight bytes.
std::uint64_t HashOf(std::string_view text)
{
    const auto load = [&](std::size_t position) {
        std::uint64_t word;
        std::memcpy(&word, text.data() + position, sizeof word);
        return word;
    };
    std::uint64_t hash = text.size() * kFactor;
    for (std::size_t position = 0; position + 8 < text.size(); position += 8) {
        hash = (hash ^ load(position)) * kFactor ^ hash >> 32;
    }
    return (hash ^ load(text.size() - 8)) * kFactor;
}

}  // namespace

TCIMValue TTextPool::MakeValue(std::string_view text)
{
    if (text.size() <= TValueAccess::kShortTextSize || text.size() > TTextRun::kLongestText) {
        return TCIMValue::FromText(text);
    }
    const std::uint64_t hash = HashOf(text);
    const auto mark = static_cast<std::uint32_t>(hash);
    TBucket& bucket = fBuckets[hash >> 54];
    if (bucket.hash == mark && bucket.text && bucket.text->GetText() == text) {
        return TValueAccess::FromSharedText(bucket.text);
    }
    if (std::exchange(bucket.last, mark) != mark) {
        return MakeInRun(text);
    }
    bucket.text = TSharedText::Create(text);
    bucket.hash = mark;
    return TValueAccess::FromSharedText(bucket.text);
}

TCIMValue TTextPool::MakeInRun(std::string_view text)
{
    TTextRun::TPointer& run = *fFilled;
    if (!run || !run->HasRoomFor(text.size())) {
        const bool isFirst = !run && fFilled != &fRun;
        run = TTextRun::Create(isFirst ? kFirstRunSize : TTextRun::kSize);
    }
    const std::uint16_t offset = run->Append(text);
    return TValueAccess::FromRun(*run, offset, static_cast<std::uint16_t>(text.size()));
}

}  // namespace NORVZEL20

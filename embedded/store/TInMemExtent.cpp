// The instances of a class and the index of their keys.
//
// Instances stand in a list in order of insertion. An index finds the position of an instance by the hash of its keys; the keys
// themselves stay in the instances. Keys are compared as TCIMValue::IsSameKey does, so two instances are the same here if and only
// if their paths have the same text. The keys that count are those with which an instance was added: if a key property is changed
// later, the instance remembers the old value and is still found by it.
//
// A removed instance leaves a gap in the list, so positions and the index stay as they are. When more than half of the list are
// gaps, it is closed up, but never while a callback runs through it.
//
// When the class gets or loses a key, or the text of a reference in a key changes, all hashes change. They are not computed at once
// but when the index is next needed (Refresh), so loading a schema change by change costs one pass.

#include "embedded/store/TInMemExtent.h"

#include <algorithm>
#include <limits>
#include <new>

#include "embedded/store/TStoreRefusal.h"
#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kMinCompactedSize = 32;  // gaps in a list up to this length are not worth a pass

constexpr std::size_t kRecentInstances = 8;  // enough for the properties in which one instance after the other differs

/// The hash of the keys before `key`, which is `seed`, and of `key`.
std::uint32_t Mix(std::uint32_t seed, const TCIMValue& key)
{
    const std::uint64_t hash = key.KeyHash();
    return (seed ^ static_cast<std::uint32_t>(hash ^ (hash >> 32))) * 0x01000193U + 0x9e3779b9U;
}

/// While one of these lives, a callback runs, and positions in the list must not change.
class TEnumeration {
  public:
    explicit TEnumeration(unsigned int& count) noexcept : fCount(count) { ++fCount; }
    TEnumeration(const TEnumeration&) = delete;
    TEnumeration& operator=(const TEnumeration&) = delete;
    ~TEnumeration() { --fCount; }

  private:
    unsigned int& fCount;
};

}  // namespace

TInMemExtent::~TInMemExtent()
{
    Clear();
}

void TInMemExtent::Add(const boost::shared_ptr<TInMemInstance>& instance)
{
    CheckKeysAreSet(*instance);
    Refresh();
    // Room first: once the index has the instance, nothing may fail.
    if (fInstances.size() == fInstances.capacity()) {
        fInstances.reserve(fInstances.size() + fInstances.size() / 2 + 2);  // doubling would waste much
    }
    fIndex.Reserve(fCount + 1);
    FillGeneratedKeys(*instance);
    const std::uint32_t hash = HashOf(*instance);
    CheckKeysAreFree(hash, *instance);
    fIndex.Add(hash, static_cast<std::uint32_t>(fInstances.size()));
    fInstances.push_back(instance);
    instance->SetAdded(hash);
    SkipGenerated(*instance);
    ++fCount;
}

void TInMemExtent::Check(const TInMemInstance& instance) const
{
    CheckKeysAreSet(instance);
    for (const std::uint32_t slot : fLayout.GetKeys()) {
        if (instance.GetSlotValue(slot).IsNull()) {
            return;  // it will get a number that no other instance has
        }
    }
    Refresh();
    CheckKeysAreFree(HashOf(instance), instance);
}

void TInMemExtent::CheckKeysAreSet(const TInMemInstance& instance) const
{
    if (instance.IsAdded()) {
        throw TStoreRefusal(TZELStatusCode::kInvalidParameter,
                            [&] { return "instance " + TStoreRefusal::Shown(instance.GetReference()) + " is added already"; });
    }
    if (const std::string* const missing = instance.FindMissingKey()) {
        throw TStoreRefusal(TZELStatusCode::kKeyMissing,
                            [&] { return "key " + *missing + " of instance " + TStoreRefusal::Shown(instance.GetReference()); });
    }
}

void TInMemExtent::CheckKeysAreFree(std::uint32_t hash, const TInMemInstance& instance) const
{
    const auto isSame = [&](std::uint32_t ordinal) { return HasSameKeys(*fInstances[ordinal], instance); };
    if (fIndex.Find(hash, isSame) != THashIndex::kNone) {
        throw TStoreRefusal(TZELStatusCode::kAlreadyExists,
                            [&] { return "instance " + TStoreRefusal::Shown(instance.GetReference()); });
    }
}

void TInMemExtent::FillGeneratedKeys(TInMemInstance& instance)
{
    for (const std::uint32_t slot : fLayout.GetKeys()) {
        if (instance.GetSlotValue(slot).IsNull()) {
            instance.SetSlot(slot, TCIMValue(fNextGenerated));
        }
    }
}

/// Numbers that are given in an inventory are not generated again.
void TInMemExtent::SkipGenerated(const TInMemInstance& instance) noexcept
{
    for (const std::uint32_t slot : fLayout.GetKeys()) {
        if (!fLayout.GetDecl(slot).IsGenerated()) {
            continue;
        }
        const TCIMValue& key = instance.GetSlotValue(slot);
        if (key.GetType() != TCIMValue::TCIMType::kUint64) {
            continue;  // a load may have kept text that is no number
        }
        const std::uint64_t number = key.GetUnsigned();
        if (number >= fNextGenerated && number < std::numeric_limits<std::uint64_t>::max()) {
            fNextGenerated = number + 1;
        }
    }
}

std::uint32_t TInMemExtent::HashOf(const TInMemInstance& instance) const
{
    std::uint32_t hash = 0;
    for (const std::uint32_t slot : fLayout.GetKeys()) {
        hash = Mix(hash, instance.GetAddedKey(slot));
    }
    return hash;
}

bool TInMemExtent::HasSameKeys(const TInMemInstance& a, const TInMemInstance& b) const
{
    for (const std::uint32_t slot : fLayout.GetKeys()) {
        if (!a.GetAddedKey(slot).IsSameKey(b.GetAddedKey(slot))) {
            return false;
        }
    }
    return true;
}

boost::shared_ptr<TInMemInstance> TInMemExtent::Find(const std::vector<TCIMValue>& keys) const
{
    const std::uint32_t position = FindPosition(keys);
    return position == kNoPosition ? nullptr : fInstances[position];
}

std::uint32_t TInMemExtent::FindPosition(const std::vector<TCIMValue>& keys) const
{
    Refresh();
    std::uint32_t hash = 0;
    for (const TCIMValue& key : keys) {
        hash = Mix(hash, key);
    }
    const std::vector<std::uint32_t>& slots = fLayout.GetKeys();
    const auto isSame = [&](std::uint32_t ordinal) {
        for (std::size_t at = 0; at < keys.size(); ++at) {
            if (!fInstances[ordinal]->GetAddedKey(slots[at]).IsSameKey(keys[at])) {
                return false;
            }
        }
        return true;
    };
    return fIndex.Find(hash, isSame);
}

bool TInMemExtent::Remove(const TInMemInstance& instance)
{
    const auto isIt = [&](std::uint32_t ordinal) { return fInstances[ordinal].get() == &instance; };
    // The hash is the one that the instance was indexed with, so this also works while the index is stale.
    const std::uint32_t ordinal = fIndex.Find(instance.GetKeyHash(), isIt);
    if (ordinal == THashIndex::kNone) {
        return false;
    }
    fIndex.Remove(instance.GetKeyHash(), ordinal);
    fInstances[ordinal]->SetRemoved();
    fInstances[ordinal].reset();
    --fCount;
    if (fEnumerations == 0 && fInstances.size() > kMinCompactedSize && fCount < fInstances.size() / 2) {
        CompactIfPossible();
    }
    return true;
}

/// Closes the gaps. If memory is short, they stay until the next removal.
void TInMemExtent::CompactIfPossible() noexcept
{
    try {
        Compact();
    } catch (const std::bad_alloc&) {
    }
}

void TInMemExtent::Compact()
{
    THashIndex index;
    index.Reserve(fCount);
    std::uint32_t kept = 0;
    for (auto& instance : fInstances) {
        if (instance) {
            index.Add(instance->GetKeyHash(), kept);
            fInstances[kept++].swap(instance);
        }
    }
    fInstances.resize(kept);
    fIndex.Swap(index);
}

void TInMemExtent::Clear() noexcept
{
    // Empty the extent before the first instance is released.
    std::vector<boost::shared_ptr<TInMemInstance>> instances;
    instances.swap(fInstances);
    fIndex.Clear();
    fCount = 0;
    for (const auto& instance : instances) {
        if (instance) {
            instance->SetRemoved();
        }
    }
}

void TInMemExtent::ShareRecent(std::uint32_t slot, TCIMValue& value) const
{
    if (!TValueAccess::HasBlock(value)) {
        return;
    }
    const TCIMValue* like = nullptr;
    const std::size_t end = fInstances.size();
    for (std::size_t back = 1; back <= std::min(end, kRecentInstances); ++back) {
        const TCIMValue* const recent = fInstances[end - back] ? fInstances[end - back]->FindOwnValue(slot) : nullptr;
        if (recent && TValueAccess::IsIndistinguishable(*recent, value)) {
            value = *recent;
            return;
        }
        like = !like && recent && TValueAccess::HasSameFrame(*recent, value) ? recent : like;
    }
    if (like) {
        TValueAccess::ShareFrame(value, *like);
    }
}

bool TInMemExtent::Enumerate(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback) const
{
    const TEnumeration enumeration(fEnumerations);
    const std::size_t end = fInstances.size();
    for (std::size_t at = 0; at < end && at < fInstances.size(); ++at) {
        if (fInstances[at] && !callback(fInstances[at])) {
            return false;
        }
    }
    return true;
}

TInMemExtent::TMark TInMemExtent::GetMark() const noexcept
{
    return {static_cast<std::uint32_t>(fInstances.size()), fNextGenerated};
}

void TInMemExtent::RollBack(const TMark& mark) noexcept
{
    // From the end, so the positions of the instances that stay do not change.
    while (fInstances.size() > mark.size) {
        TInMemInstance& instance = *fInstances.back();
        fIndex.Remove(instance.GetKeyHash(), static_cast<std::uint32_t>(fInstances.size() - 1));
        instance.SetRemoved();
        fInstances.pop_back();
        --fCount;
    }
    fNextGenerated = mark.nextGenerated;
}

void TInMemExtent::Refresh() const
{
    if (fKeyVersion != fLayout.GetKeyVersion() || (fTextVersion != fCurrentTextVersion && HasKeysWithReferences())) {
        Reindex();
    }
    fTextVersion = fCurrentTextVersion;
}

/// Embedded objects hold references too, and are strings.
bool TInMemExtent::HasKeysWithReferences() const noexcept
{
    const std::vector<std::uint32_t>& keys = fLayout.GetKeys();
    return std::any_of(keys.begin(), keys.end(), [this](std::uint32_t slot) {
        const TCIMValue::TCIMType type = fLayout.GetDecl(slot).GetType().GetElementType();
        return type == TCIMValue::TCIMType::kReference || type == TCIMValue::TCIMType::kString;
    });
}

void TInMemExtent::Reindex() const
{
    // Computing a hash may fail. Only when all are there do the instances get them; until then the old index is right.
    std::vector<std::uint32_t> hashes(fInstances.size());
    THashIndex index;
    index.Reserve(fCount);
    for (std::uint32_t ordinal = 0; ordinal < fInstances.size(); ++ordinal) {
        if (fInstances[ordinal]) {
            hashes[ordinal] = HashOf(*fInstances[ordinal]);
            index.Add(hashes[ordinal], ordinal);
        }
    }
    for (std::uint32_t ordinal = 0; ordinal < fInstances.size(); ++ordinal) {
        if (fInstances[ordinal]) {
            fInstances[ordinal]->SetAdded(hashes[ordinal]);
        }
    }
    fIndex.Swap(index);
    fKeyVersion = fLayout.GetKeyVersion();
}

}  // namespace NORVZEL20

#include "embedded/store/TInMemExtent.h"

#include <limits>
#include <new>

#include "embedded/store/TInMemClass.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

std::uint32_t Mix(std::uint32_t seed, const TCIMValue& key)
{
    const std::uint64_t hash = key.Hash();
    return (seed ^ static_cast<std::uint32_t>(hash ^ (hash >> 32))) * 0x01000193U + 0x9e3779b9U;
}

/// Keeps the positions from changing while a callback runs.
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
    CheckKeys(*instance);
    Refresh();
    if (fInstances.size() == fInstances.capacity()) {
        fInstances.reserve(fInstances.size() + fInstances.size() / 2 + 2);
    }
    fIndex.Reserve(fCount + 1);
    FillGenerated(*instance);
    const std::uint32_t hash = HashOf(*instance);
    CheckNew(hash, *instance);
    fIndex.Add(hash, static_cast<std::uint32_t>(fInstances.size()));
    fInstances.push_back(instance);
    instance->SetAdded(hash);
    CountGenerated(*instance);
    ++fCount;
}

void TInMemExtent::Check(const TInMemInstance& instance) const
{
    CheckKeys(instance);
    for (const std::uint32_t slot : fClass.GetKeySlots()) {
        if (instance.GetSlotValue(slot).IsNull()) {
            return;  // a number of its own will be generated
        }
    }
    Refresh();
    CheckNew(HashOf(instance), instance);
}

void TInMemExtent::CheckKeys(const TInMemInstance& instance) const
{
    if (instance.IsAdded()) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    if (instance.FindMissingKey()) {
        throw TZELException(TZELStatusCode::kKeyMissing);
    }
}

void TInMemExtent::CheckNew(std::uint32_t hash, const TInMemInstance& instance) const
{
    const auto isSame = [&](std::uint32_t ordinal) { return HasSameKeys(*fInstances[ordinal], instance); };
    if (fIndex.Find(hash, isSame) != THashIndex::kNone) {
        throw TZELException(TZELStatusCode::kAlreadyExists);
    }
}

void TInMemExtent::FillGenerated(TInMemInstance& instance)
{
    for (const std::uint32_t slot : fClass.GetKeySlots()) {
        if (instance.GetSlotValue(slot).IsNull()) {
            instance.SetSlot(slot, TCIMValue(fNextGenerated));
        }
    }
}

void TInMemExtent::CountGenerated(const TInMemInstance& instance) noexcept
{
    for (const std::uint32_t slot : fClass.GetKeySlots()) {
        if (!fClass.GetSlotDecl(slot).IsGenerated()) {
            continue;
        }
        const std::uint64_t number = instance.GetSlotValue(slot).GetUnsigned();
        if (number >= fNextGenerated && number < std::numeric_limits<std::uint64_t>::max()) {
            fNextGenerated = number + 1;
        }
    }
}

std::uint32_t TInMemExtent::HashOf(const TInMemInstance& instance) const
{
    std::uint32_t hash = 0;
    for (const std::uint32_t slot : fClass.GetKeySlots()) {
        hash = Mix(hash, instance.GetAddedKey(slot));
    }
    return hash;
}

bool TInMemExtent::HasSameKeys(const TInMemInstance& a, const TInMemInstance& b) const
{
    for (const std::uint32_t slot : fClass.GetKeySlots()) {
        if (a.GetAddedKey(slot) != b.GetAddedKey(slot)) {
            return false;
        }
    }
    return true;
}

boost::shared_ptr<TInMemInstance> TInMemExtent::Find(const std::vector<TCIMValue>& keys) const
{
    Refresh();
    std::uint32_t hash = 0;
    for (const TCIMValue& key : keys) {
        hash = Mix(hash, key);
    }
    const std::vector<std::uint32_t>& slots = fClass.GetKeySlots();
    const auto isSame = [&](std::uint32_t ordinal) {
        for (std::size_t at = 0; at < keys.size(); ++at) {
            if (fInstances[ordinal]->GetAddedKey(slots[at]) != keys[at]) {
                return false;
            }
        }
        return true;
    };
    const std::uint32_t found = fIndex.Find(hash, isSame);
    return found == THashIndex::kNone ? nullptr : fInstances[found];
}

bool TInMemExtent::Remove(const TInMemInstance& instance)
{
    const auto isIt = [&](std::uint32_t ordinal) { return fInstances[ordinal].get() == &instance; };
    const std::uint32_t ordinal = fIndex.Find(instance.fKeyHash, isIt);
    if (ordinal == THashIndex::kNone) {
        return false;
    }
    fIndex.Remove(instance.fKeyHash, ordinal);
    fInstances[ordinal]->SetRemoved();
    fInstances[ordinal].reset();
    --fCount;
    if (fEnumerations == 0 && fInstances.size() > 32 && fCount < fInstances.size() / 2) {
        CompactIfPossible();
    }
    return true;
}

/// The instance is gone; where memory is short, the next removal tidies up.
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
            index.Add(instance->fKeyHash, kept);
            fInstances[kept++].swap(instance);
        }
    }
    fInstances.resize(kept);
    fIndex.Swap(index);
}

void TInMemExtent::Clear() noexcept
{
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
    while (fInstances.size() > mark.size) {
        TInMemInstance& instance = *fInstances.back();
        fIndex.Remove(instance.fKeyHash, static_cast<std::uint32_t>(fInstances.size() - 1));
        instance.SetRemoved();
        fInstances.pop_back();
        --fCount;
    }
    fNextGenerated = mark.nextGenerated;
}

void TInMemExtent::Refresh() const
{
    if (!fIsStale) {
        return;
    }
    // Hashing may fail, and the instances must not be touched before it has not.
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
            fInstances[ordinal]->fKeyHash = hashes[ordinal];
        }
    }
    fIndex.Swap(index);
    fIsStale = false;
}

}  // namespace NORVZEL20

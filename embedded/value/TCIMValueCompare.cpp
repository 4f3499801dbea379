// Equality and hash of values.
//
// Nulls of any types are equal. Other values of different types are different, even if their numbers are equal. Values of
// the same type are compared by what they mean: -0 equals 0, every NaN equals every other, datetimes are equal if their instants
// are. Equal values have the same hash.
//
// Bags are compared as multisets. Both are sorted by the hashes of their elements; if the sequences of hashes differ, the bags
// differ. Otherwise each run of equal hashes on the left is paired off with the run on the right. Different elements rarely share
// a hash, so a run is short or consists of equal elements, and the whole takes n log n steps.
//
// As keys, two values are the same if their key texts are. For everything that a key usually is, equality by value is the same
// relation and needs no texts.

#include <algorithm>
#include <cmath>
#include <functional>

#include "embedded/value/TCountedBlocks.h"
#include "embedded/value/TTypeKind.h"
#include "embedded/value/TValueAccess.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

namespace {

using TAccess = TValueAccess;

/// True for two NaNs too, which the operator == of double denies.
bool EqualReals(double a, double b) noexcept
{
    return !(a < b) && !(a > b) && std::isnan(a) == std::isnan(b);
}

bool EqualInOrder(const std::vector<TCIMValue>& a, const std::vector<TCIMValue>& b)
{
    return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin());
}

using THashed = std::pair<std::size_t, const TCIMValue*>;

std::vector<THashed> SortByHash(const std::vector<TCIMValue>& elements)
{
    std::vector<THashed> result;
    result.reserve(elements.size());
    for (const TCIMValue& element : elements) {
        result.emplace_back(element.Hash(), &element);
    }
    std::sort(result.begin(), result.end());
    return result;
}

/// Whether each element of a run equals an element of the other run, each used once. In runs of equal elements the first candidate
/// always fits.
bool PairOff(std::vector<THashed>::const_iterator first, std::vector<THashed>::const_iterator last,
             std::vector<THashed>::iterator candidates)
{
    for (const auto runEnd = candidates + (last - first); first != last; ++first, ++candidates) {
        const auto match = std::find_if(candidates, runEnd, [&first](const THashed& c) { return *first->second == *c.second; });
        if (match == runEnd) {
            return false;
        }
        std::iter_swap(candidates, match);
    }
    return true;
}

bool EqualAsBags(const std::vector<TCIMValue>& a, const std::vector<TCIMValue>& b)
{
    if (a.size() != b.size()) {
        return false;
    }
    const std::vector<THashed> left = SortByHash(a);
    std::vector<THashed> right = SortByHash(b);
    const auto sameHash = [](const THashed& x, const THashed& y) { return x.first == y.first; };
    if (!std::equal(left.begin(), left.end(), right.begin(), sameHash)) {
        return false;
    }
    for (auto run = left.begin(); run != left.end();) {
        const auto end = std::find_if(run, left.end(), [run](const THashed& x) { return x.first != run->first; });
        if (!PairOff(run, end, right.begin() + (run - left.begin()))) {
            return false;
        }
        run = end;
    }
    return true;
}

/// Depends on the order: a mix of a and b is not one of b and a.
std::size_t Mix(std::size_t hash, std::size_t more) noexcept
{
    return (hash ^ more) * 0x9E3779B97F4A7C15u + (more >> 29);
}

std::string GetKeyText(const TCIMValue& value)
{
    std::string text;
    value.AppendKeyText(text);
    return text;
}

}  // namespace

bool TCIMValue::operator==(const TCIMValue& other) const
{
    // The same bytes mean the same value, and the same block means the same contents.
    if (TAccess::HasSameBytes(*this, other)) {
        return true;
    }
    if (IsNull() || other.IsNull()) {
        return IsNull() && other.IsNull();
    }
    if (fType != other.fType) {
        return false;
    }
    switch (fForm) {
    case TAccess::kNumber:
        return TTypeKind::IsReal(fType) && EqualReals(TAccess::GetReal(*this), TAccess::GetReal(other));
    case TAccess::kDateTime:
        return TAccess::LoadDateTime(*this) == TAccess::LoadDateTime(other);
    case TAccess::kObject:
        return other.fForm == TAccess::kObject && *GetEmbeddedObject() == *other.GetEmbeddedObject();
    case TAccess::kArray:
        return EqualInOrder(GetElements(), other.GetElements());
    case TAccess::kBag:
        return EqualAsBags(GetElements(), other.GetElements());
    case TAccess::kPath:
        return TAccess::GetPath(*this).GetPath() == TAccess::GetPath(other).GetPath();
    default:
        return TAccess::IsText(other) && TAccess::GetText(*this) == TAccess::GetText(other);
    }
}

std::size_t TCIMValue::Hash() const
{
    switch (fForm) {
    case TAccess::kNull:
        return 0;
    case TAccess::kNumber:
        // Any number will do for NaN; a tiny one hardly ever occurs.
        return TTypeKind::IsReal(fType) ? std::hash<double>()(std::isnan(GetReal()) ? 1e-300 : GetReal())
                                        : Mix(fType, static_cast<std::size_t>(TAccess::GetBits(*this)));
    case TAccess::kDateTime:
        return Mix(static_cast<std::size_t>(TAccess::LoadDateTime(*this).GetMicroseconds()),
                   TAccess::LoadDateTime(*this).GetUnknown());
    case TAccess::kObject:
        return GetEmbeddedObject()->Hash();
    case TAccess::kArray:
    case TAccess::kBag: {
        std::size_t hash = GetElements().size();
        for (const TCIMValue& element : GetElements()) {
            hash = Mix(hash, element.Hash());
        }
        return hash;
    }
    case TAccess::kPath:
        return std::hash<std::string>()(TAccess::GetPath(*this).GetPath());
    default:
        return std::hash<std::string_view>()(TAccess::GetText(*this));
    }
}

bool TCIMValue::IsKeyByText() const noexcept
{
    return fForm == TAccess::kObject || fForm == TAccess::kArray || fForm == TAccess::kBag;
}

bool TCIMValue::IsSameKey(const TCIMValue& other) const
{
    if (!IsKeyByText() && !other.IsKeyByText()) {
        return *this == other;
    }
    return fType == other.fType && GetKeyText(*this) == GetKeyText(other);
}

std::size_t TCIMValue::KeyHash() const
{
    if (fForm == TAccess::kObject) {
        return std::hash<std::string_view>()(GetEmbeddedObject()->GetKeyText());  // as plain text
    }
    return IsKeyByText() ? std::hash<std::string>()(GetKeyText(*this)) : Hash();
}

}  // namespace NORVZEL20

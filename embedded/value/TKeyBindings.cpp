#include "embedded/value/TKeyBindings.h"

#include <algorithm>
#include <new>
#include <utility>

#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLongestKeptName = 64;  // longer ones are rare, and their memory is given back

}  // namespace

TKeyBindings::TKeyBindings(const TKeyBindings& other) : TKeyBindings()
{
    Reserve(other.fCount);
    fFrame = other.fFrame;
    std::copy(other.GetValues(), other.GetValues() + other.fCount, GetValues());
    fCount = other.fCount;
}

TKeyBindings::~TKeyBindings()
{
    FreeValues();
}

void TKeyBindings::FreeValues() noexcept
{
    if (fCapacity > 1) {
        delete[] fMany;
    } else {
        fOne.~TCIMValue();
    }
}

TPathFrame& TKeyBindings::OwnFrame()
{
    if (!fFrame) {
        fFrame.reset(new TPathFrame, false);
    } else if (!fFrame->IsUnique()) {
        fFrame.reset(new TPathFrame(*fFrame, fCount), false);
    }
    return *fFrame;
}

void TKeyBindings::Reserve(std::size_t count)
{
    if (count <= fCapacity) {
        return;
    }
    TCIMValue* const values = new TCIMValue[count];
    for (std::size_t position = 0; position < fCount; ++position) {
        TValueAccess::MoveToNull(values[position], GetValues()[position]);
    }
    FreeValues();
    fMany = values;
    fCapacity = static_cast<std::uint32_t>(count);
}

void TKeyBindings::Append(std::string&& name, const TCIMValue& value)
{
    MakeRoom();
    InsertName(fCount, std::move(name));
    InsertValue(fCount, value);
}

void TKeyBindings::Insert(std::size_t position, const std::string& name, const TCIMValue& value)
{
    MakeRoom();
    // The frame often has the name already, from the bindings before.
    const bool isThere = position == fCount && fFrame && fFrame->names.size() > fCount && fFrame->names[fCount] == name;
    if (!isThere) {
        InsertName(position, std::string(name));
    }
    InsertValue(position, value);
}

void TKeyBindings::MakeRoom()
{
    if (fCount == fCapacity) {
        Reserve(std::size_t{2} * fCount);
    }
}

/// Afterwards the frame has the names in front of `position`, then `name`, then those of the other bindings.
void TKeyBindings::InsertName(std::size_t position, std::string&& name)
{
    std::vector<std::string>& names = OwnFrame().names;
    names.reserve(std::max<std::size_t>(fCount + std::size_t{1}, fCapacity));
    if (position == fCount && fCount < names.size()) {
        names[position] = std::move(name);
        return;
    }
    names.resize(fCount);
    names.insert(names.begin() + static_cast<std::ptrdiff_t>(position), std::move(name));
}

void TKeyBindings::InsertValue(std::size_t position, const TCIMValue& value) noexcept
{
    TCIMValue* const values = GetValues();
    values[fCount] = value;
    std::rotate(values + position, values + fCount, values + fCount + 1);
    ++fCount;
}

void TKeyBindings::Clear() noexcept
{
    for (std::uint32_t position = 0; position < fCount; ++position) {
        const TCIMValue ended(std::move(GetValues()[position]));
    }
    fCount = 0;
    if (!fFrame) {
        return;
    }
    const auto isLong = [](const std::string& name) { return name.capacity() > kLongestKeptName; };
    if (!fFrame->IsUnique() || std::any_of(fFrame->names.begin(), fFrame->names.end(), isLong)) {
        fFrame.reset();
        return;
    }
    fFrame->place.reset();
    fFrame->cls.reset();
}

bool TKeyBindings::HasSameFrame(const TKeyBindings& other) const noexcept
{
    if (fCount != other.fCount || fFrame == other.fFrame || !fFrame || !other.fFrame) {
        return fCount == other.fCount && fFrame == other.fFrame;
    }
    return fFrame->cls == other.fFrame->cls && fFrame->HasSamePlace(*other.fFrame) &&
           std::equal(fFrame->names.begin(), fFrame->names.begin() + fCount, other.fFrame->names.begin());
}

}  // namespace NORVZEL20

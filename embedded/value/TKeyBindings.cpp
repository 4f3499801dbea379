#include "embedded/value/TKeyBindings.h"

#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLongestKeptName = 64;  // longer ones are rare, and their memory is given back

}  // namespace

void TKeyBindings::Append(const std::string& name, const TCIMValue& value)
{
    if (fCount == fBindings.size()) {
        fBindings.emplace_back(name, value);
    } else {
        TBinding& spare = fBindings[fCount];
        if (spare.first != name) {
            spare.first = name;
        }
        TCIMValue copy(value);
        TValueAccess::MoveToNull(spare.second, copy);
    }
    ++fCount;
}

void TKeyBindings::Append(std::string&& name, TCIMValue&& value)
{
    DropSpares();
    fBindings.emplace_back(std::move(name), std::move(value));
    ++fCount;
}

void TKeyBindings::Insert(const TBinding* place, const std::string& name, const TCIMValue& value)
{
    const auto position = place - begin();
    DropSpares();
    fBindings.emplace(fBindings.begin() + position, name, value);
    ++fCount;
}

void TKeyBindings::Clear() noexcept
{
    for (TBinding& binding : *this) {
        const TCIMValue ended(std::move(binding.second));
        if (binding.first.capacity() > kLongestKeptName) {
            binding.first = std::string();
        }
    }
    fCount = 0;
}

}  // namespace NORVZEL20

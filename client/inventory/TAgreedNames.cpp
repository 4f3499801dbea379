#include "client/inventory/TAgreedNames.h"

#include <algorithm>

namespace NORVZEL20 {

bool TAgreedNames::Covers(const TInMemClass& cls) const
{
    const auto known = fClasses.find(std::string_view(cls.GetName()));
    if (known == fClasses.end() || known->second.className != cls.GetName()) {
        return false;
    }
    const TInMemLayout& layout = cls.GetLayout();
    return std::all_of(layout.GetOrder().begin(), layout.GetOrder().end(),
                       [&](std::uint32_t slot) { return known->second.properties.count(layout.GetDecl(slot).GetName()) != 0; });
}

void TAgreedNames::Add(const TInMemClass& cls)
{
    TEntry& entry = fClasses[cls.GetName()];
    entry.className = cls.GetName();
    entry.properties.clear();
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        entry.properties.insert(cls.GetLayout().GetDecl(slot).GetName());
    }
}

void TAgreedNames::Forget(const TInMemClass& cls)
{
    const auto known = fClasses.find(std::string_view(cls.GetName()));
    if (known != fClasses.end()) {
        fClasses.erase(known);
    }
}

void TAgreedNames::Respelled(const TInMemClass& cls, const std::string& property)
{
    const auto known = fClasses.find(std::string_view(cls.GetName()));
    if (known != fClasses.end() && known->second.properties.count(property) == 0) {
        Forget(cls);
    }
}

}  // namespace NORVZEL20

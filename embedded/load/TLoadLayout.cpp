#include "embedded/load/TLoadLayout.h"

#include <utility>

namespace NORVZEL20 {

TLoadLayout::TLoadLayout(boost::shared_ptr<TInMemClass> ofClass) : cls(std::move(ofClass)), targets(cls->GetLayout().GetSlotCount())
{
    for (std::uint32_t slot = 0; slot < targets.size(); ++slot) {
        const TInMemPropertyDecl& decl = cls->GetLayout().GetDecl(slot);
        TLoadTarget& target = targets[slot];
        target.name = &decl.GetName();
        target.slot = slot;
        target.type = decl.GetType();
        target.isEmbedded = decl.HoldsObjects();
        target.isStatic = decl.IsStatic();
        target.isKeptAsIs = !decl.IsStatic() && !decl.IsBag();
    }
    TLoadTarget** link = &first;
    for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
        *link = &targets[slot];
        link = &targets[slot].next;
    }
}

}  // namespace NORVZEL20

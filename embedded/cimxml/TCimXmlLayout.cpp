#include "embedded/cimxml/TCimXmlLayout.h"

#include <utility>

namespace NORVZEL20 {

TCimXmlLayout::TCimXmlLayout(boost::shared_ptr<TInMemClass> ofClass)
    : cls(std::move(ofClass)), positions(cls->GetLayout().GetSlotCount()), given(cls->GetLayout().GetSlotCount()),
      tags(cls->GetLayout().GetSlotCount())
{
    for (std::uint32_t slot = 0; slot < cls->GetLayout().GetSlotCount(); ++slot) {
        embedded.push_back(cls->GetLayout().GetDecl(slot).HoldsObjects());
    }
    const std::vector<std::uint32_t>& order = cls->GetLayout().GetOrder();
    for (std::uint32_t position = 0; position < order.size(); ++position) {
        positions[order[position]] = position;
    }
}

}  // namespace NORVZEL20

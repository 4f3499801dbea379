#include "embedded/cimxml/TCimXmlLayout.h"

#include <utility>

namespace NORVZEL20 {

namespace {

/// Whether text in the property is an embedded object, as its qualifiers say, for documents that do not mark the value.
bool HoldsObjects(const TInMemPropertyDecl& decl)
{
    if (decl.GetType().GetElementType() != TCIMValue::TCIMType::kString) {
        return false;
    }
    return decl.GetQualifiers().IsTrue("EmbeddedObject") || decl.GetQualifiers().Find("EmbeddedInstance");
}

}  // namespace

TCimXmlLayout::TCimXmlLayout(boost::shared_ptr<TInMemClass> ofClass)
    : cls(std::move(ofClass)), positions(cls->GetLayout().GetSlotCount()), given(cls->GetLayout().GetSlotCount())
{
    for (std::uint32_t slot = 0; slot < cls->GetLayout().GetSlotCount(); ++slot) {
        embedded.push_back(HoldsObjects(cls->GetLayout().GetDecl(slot)));
    }
    const std::vector<std::uint32_t>& order = cls->GetLayout().GetOrder();
    for (std::uint32_t position = 0; position < order.size(); ++position) {
        positions[order[position]] = position;
    }
}

}  // namespace NORVZEL20

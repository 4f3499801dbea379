#include "client/comparison/ReferenceStandIns.h"

#include <algorithm>

#include "client/inventory/CollectObjects.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/value/TValueText.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

bool IsReference(TCIMValue::TCIMType type)
{
    return type == TCIMValue::TCIMType::kReference;
}

// No class has a parenthesis in its name, so no path of an inventory has the text of a stand-in. If the property is a key, the text
// is what reports show in the path.
TCIMValue StandInFor(const TCIMValue& value)
{
    TCIMReference path;
    path.SetClassName("(" + TValueText::DescribeType(value.GetType()) + ") " + value.ToText());
    return TCIMValue(path);
}

void PutIntoStatic(TInMemStaticProperty& shared)
{
    // Classes share a static value, so it may have its stand-in already.
    if (!shared.GetValue().IsNull() && !IsReference(shared.GetValue().GetType())) {
        shared.MarkStandIn(StandInFor(shared.GetValue()));
    }
}

void PutIntoSlot(TInMemClass& cls, std::uint32_t slot)
{
    if (cls.GetLayout().GetDecl(slot).IsStatic()) {
        PutIntoStatic(cls.GetLayout().GetSharedDecl(slot)->GetStaticProperty());
        return;
    }
    for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(cls)) {
        const auto& stored = static_cast<const TInMemInstance&>(*instance);  // an in-memory class has no other instances
        if (!stored.GetSlotValue(slot).IsNull() && !IsReference(stored.GetSlotValue(slot).GetType())) {
            stored.GetSlotProperty(slot).MarkStandIn(StandInFor(stored.GetSlotValue(slot)));
        }
    }
}

void PutInto(TInMemClass& cls, const std::string& property)
{
    const std::uint32_t slot = cls.GetLayout().FindSlot(property);
    if (slot != TInMemLayout::kNoSlot && !IsReference(cls.GetLayout().GetDecl(slot).GetType())) {
        PutIntoSlot(cls, slot);
    }
}

void PutIntoReference(const TInMemNamespace& ns, const TBadProperty& bad)
{
    const boost::shared_ptr<TInMemClass> cls = ns.FindClass(bad.className);
    const std::uint32_t slot = cls ? cls->GetLayout().FindSlot(bad.property) : TInMemLayout::kNoSlot;
    if (bad.isKeptAsText && slot != TInMemLayout::kNoSlot && IsReference(cls->GetLayout().GetDecl(slot).GetType())) {
        PutIntoSlot(*cls, slot);
    }
}

}  // namespace

bool KeepsText(const TInventory& inventory)
{
    const std::vector<TBadProperty>& found = inventory.loaded.badProperties;
    return std::any_of(found.begin(), found.end(), [](const TBadProperty& bad) { return bad.isKeptAsText; });
}

void PutTextStandIns(const std::vector<TInventory>& inventories)
{
    for (const TInventory& inventory : inventories) {
        for (const TBadProperty& bad : inventory.loaded.badProperties) {
            PutIntoReference(*inventory.ns, bad);
        }
    }
}

void PutReferenceStandIns(const std::vector<TInventory>& inventories)
{
    for (const boost::shared_ptr<TInMemClass>& cls : inventories.front().ns->GetClasses()) {
        for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
            const bool isReference = IsReference(cls->GetLayout().GetDecl(slot).GetType());
            for (std::size_t other = 1; isReference && other < inventories.size(); ++other) {
                if (const boost::shared_ptr<TInMemClass> there = inventories[other].ns->FindClass(cls->GetName())) {
                    PutInto(*there, cls->GetLayout().GetDecl(slot).GetName());
                }
            }
        }
    }
}

}  // namespace NORVZEL20

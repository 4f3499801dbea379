#include "client/inventory/FindOwnName.h"

#include <algorithm>
#include <string_view>
#include <utility>
#include <vector>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/TSystemNames.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

// How often each name comes, in the spelling that comes first.
using TCounts = TNameMap<std::size_t>;

void AddValues(TCounts& counts, TInMemClass& cls, const std::string& property)
{
    const std::uint32_t slot = cls.GetLayout().FindSlot(property);
    if (slot == TInMemLayout::kNoSlot || cls.GetLayout().GetDecl(slot).GetType() != TCIMValue::TCIMType::kString) {
        return;
    }
    for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(cls)) {
        const TCIMValue& value = static_cast<const TInMemInstance&>(*instance).GetSlotValue(slot);
        if (!value.IsNull() && !value.GetEmbeddedObject() && !value.GetString().empty()) {
            ++counts[std::string(value.GetString())];
        }
    }
}

// Also of classes that are declared without the standard ones above them.
bool IsComputerSystem(const TInMemClass& cls)
{
    constexpr std::string_view kSuffix = "ComputerSystem";
    for (const TInMemClass* above = &cls; above != nullptr; above = above->GetSuperInMemClass().get()) {
        const std::string_view name = above->GetName();
        if (name.size() >= kSuffix.size() && TNameText::Equal(name.substr(name.size() - kSuffix.size()), kSuffix)) {
            return true;
        }
    }
    return false;
}

[[noreturn]] void Refuse(const TInventory& inventory, const std::string& property, const TCounts& counts)
{
    if (counts.empty()) {
        throw TClientError(inventory.path + ": no instance has a value of " + EscapeForDisplay(property) +
                           "; name a property that holds the system's own name behind --self, or the names themselves with --same");
    }
    std::vector<std::pair<std::string, std::size_t>> values(counts.begin(), counts.end());
    std::stable_sort(values.begin(), values.end(), [](const auto& a, const auto& b) { return a.second > b.second; });
    constexpr std::size_t kMost = 3;
    std::string list;
    for (std::size_t i = 0; i < std::min(kMost, values.size()); ++i) {
        list += (i > 0 ? ", " : "") + DisplayLabel(values[i].first) + " (" + std::to_string(values[i].second) + ")";
    }
    throw TClientError(inventory.path + ": " + EscapeForDisplay(property) + " has several values: " + list +
                       (values.size() > kMost ? " and " + std::to_string(values.size() - kMost) + " more" : "") +
                       "; say which names mean the same system with --same");
}

// The name, or an empty one. Counts the values of the property.
std::string FindAmongValues(const TInventory& inventory, const std::string& property, TCounts& counts)
{
    TCounts systems;
    for (const boost::shared_ptr<TInMemClass>& cls : inventory.ns->GetClasses()) {
        AddValues(counts, *cls, property);
        if (IsComputerSystem(*cls)) {
            AddValues(systems, *cls, "Name");
        }
    }
    if (counts.size() == 1) {
        return counts.begin()->first;
    }
    const bool isUnambiguous = TNameText::Equal(property, kSystemNameProperty) && systems.size() == 1 &&
                               (counts.empty() || counts.count(systems.begin()->first) > 0);
    return isUnambiguous ? systems.begin()->first : std::string();
}

}  // namespace

std::string FindOwnName(const TInventory& inventory, const std::string& property)
{
    TCounts counts;
    std::string name = FindAmongValues(inventory, property, counts);
    if (name.empty()) {
        Refuse(inventory, property, counts);
    }
    return name;
}

std::string FindOwnNameIfAny(const TInventory& inventory)
{
    TCounts counts;
    return FindAmongValues(inventory, kSystemNameProperty, counts);
}

}  // namespace NORVZEL20

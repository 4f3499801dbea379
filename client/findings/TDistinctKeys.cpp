#include "client/findings/TDistinctKeys.h"

#include "client/inventory/CollectObjects.h"
#include "client/inventory/PropertyValue.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

std::string ClassOf(const TCIMValue& value)
{
    if (value.IsNull() || value.GetType() != TCIMValue::TCIMType::kReference) {
        return std::string();
    }
    const TCIMReference path = value;
    return path.GetClassName();
}

}  // namespace

TDistinctKeys::TDistinctKeys(const std::vector<TInventory>& inventories, const std::string& className)
{
    for (const TInventory& inventory : inventories) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        if (!cls) {
            continue;
        }
        if (fKeys.empty()) {
            fKeys = KeyNamesOf(*cls);
        }
        const auto look = [this](const boost::shared_ptr<ICIMInstance>& instance) {
            Look(*instance);
            return !fValues.empty() || !fClasses.empty();
        };
        cls->EnumerateInstances(look, false, TCallContext());
    }
}

void TDistinctKeys::Look(const ICIMInstance& instance)
{
    const bool isFirst = fInstances++ == 0;
    for (const std::string& key : fKeys) {
        const TCIMValue value = ValueOf(instance, key);
        const std::string cls = ClassOf(value);
        if (isFirst) {
            fValues.emplace(key, value);
            fClasses.emplace(key, cls);
            continue;
        }
        const auto same = fValues.find(key);
        if (same != fValues.end() && same->second != value) {
            fValues.erase(same);
        }
        const auto sameClass = fClasses.find(key);
        if (sameClass != fClasses.end() && (cls.empty() || !TNameText::Equal(sameClass->second, cls))) {
            fClasses.erase(sameClass);
        }
    }
}

bool TDistinctKeys::IsCommon(const std::string& key, const TCIMValue& value) const
{
    const auto same = fValues.find(key);
    return fInstances > 1 && same != fValues.end() && same->second == value;
}

}  // namespace NORVZEL20

#include "client/comparison/FindNameHint.h"

#include <algorithm>
#include <set>
#include <string>
#include <utility>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/UncomparedSystems.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/value/TNameText.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

// The keys that have one text in all instances of an inventory.
class TSingleKeys {
  public:
    // The class `madeClass` has only an instance that the client made; null for none.
    TSingleKeys(const TInMemNamespace& ns, const char* madeClass)
    {
        for (const boost::shared_ptr<TInMemClass>& cls : ns.GetClasses()) {
            if (cls->GetInstanceCount() > 0 && (madeClass == nullptr || !TNameText::Equal(cls->GetName(), madeClass))) {
                Add(*cls);
            }
        }
    }

    // The text that the key has everywhere; null if it has several, or none.
    const std::string* Find(const std::string& key) const
    {
        const auto found = fValues.find(key);
        return found == fValues.end() || fSeveral.count(key) > 0 ? nullptr : &found->second;
    }

  private:
    void Add(TInMemClass& cls)
    {
        const TInMemLayout& layout = cls.GetLayout();
        for (const std::uint32_t slot : layout.GetKeys()) {
            const TInMemPropertyDecl& decl = layout.GetDecl(slot);
            if (fSeveral.count(decl.GetName()) == 0 && !HasOne(cls, slot)) {
                fSeveral.insert(decl.GetName());
            }
        }
    }

    bool HasOne(TInMemClass& cls, std::uint32_t slot)
    {
        bool hasOne = true;
        std::string* text = nullptr;
        cls.EnumerateInstances(
            [&](const boost::shared_ptr<ICIMInstance>& instance) {
                const TCIMValue& value = static_cast<const TInMemInstance&>(*instance).GetSlotValue(slot);
                hasOne = value.GetType() == TCIMValue::TCIMType::kString && !value.IsNull() && !value.GetEmbeddedObject();
                if (hasOne && text == nullptr) {
                    const std::string& name = cls.GetLayout().GetDecl(slot).GetName();
                    text = &fValues.emplace(name, std::string(value.GetString())).first->second;
                }
                hasOne = hasOne && *text == value.GetString();
                return hasOne;
            },
            false, TCallContext());
        return hasOne;
    }

    TNameMap<std::string> fValues;  // the first one of each key
    std::set<std::string, TNameText::TLess> fSeveral;
};

std::vector<TSingleKeys> FindSingleKeys(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes)
{
    const std::vector<std::size_t> made = FindMadeSystems(notes);
    std::vector<TSingleKeys> keys;
    for (std::size_t i = 0; i < inventories.size(); ++i) {
        const bool isMade = std::count(made.begin(), made.end(), i) > 0;
        keys.emplace_back(*inventories[i].ns, isMade ? kOperatingSystemClass : nullptr);
    }
    return keys;
}

std::vector<std::size_t> CountInstances(const std::vector<TInventory>& inventories, const std::string& className)
{
    std::vector<std::size_t> counts;
    for (const TInventory& inventory : inventories) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        counts.push_back(cls ? cls->GetInstanceCount() : 0);
    }
    return counts;
}

// Whether the key has one text in each inventory, and another one in each that has instances of the class than in the reference.
bool Separates(const std::vector<TSingleKeys>& keys, const std::string& key, const std::vector<std::size_t>& instances)
{
    constexpr std::size_t kFewest = 2;  // one instance has one value of each key
    const std::string* const reference = keys.front().Find(key);
    bool isAny = false;
    for (std::size_t i = 1; reference != nullptr && i < keys.size(); ++i) {
        const std::string* const other = keys[i].Find(key);
        if (other == nullptr || (instances[i] > 0 && (instances[i] < kFewest || TNameText::Equal(*other, *reference)))) {
            return false;
        }
        isAny = isAny || instances[i] > 0;
    }
    return isAny && instances.front() >= kFewest;
}

}  // namespace

std::optional<TNameHint> FindNameHint(const std::vector<TInventory>& inventories, TRules& rules,
                                      const std::vector<TSchemaNote>& notes)
{
    const std::vector<TSingleKeys> keys = FindSingleKeys(inventories, notes);
    std::optional<TNameHint> hint;
    for (const boost::shared_ptr<TInMemClass>& cls : inventories.front().ns->GetClasses()) {
        const std::vector<std::size_t> instances = CountInstances(inventories, cls->GetName());
        // Of two classes with the same number, the one that comes first by name: the order in the files has no influence.
        if (hint && std::make_pair(hint->instances.front(), cls->GetName()) >= std::make_pair(instances.front(), hint->className)) {
            continue;
        }
        for (const std::uint32_t slot : cls->GetLayout().GetKeys()) {
            const std::string& key = cls->GetLayout().GetDecl(slot).GetName();
            if (Separates(keys, key, instances) && !rules.ExcludesKey(cls->GetName(), key) && !rules.PropertiesOf(cls).empty()) {
                hint = TNameHint{cls->GetName(), key, instances};
                break;
            }
        }
    }
    return hint;
}

}  // namespace NORVZEL20

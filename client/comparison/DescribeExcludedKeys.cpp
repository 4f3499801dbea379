// What happens to a class whose rules exclude keys:
//
//   instances     Several of one inventory may have the same key. Of those of the reference the first stands for the key, and the
//                 others are not compared. Each one of another inventory is compared with that first one; if the reference has
//                 none with the key, one difference stands for them all.
//   references    The same keys, and the namespace, are left out of each pair of references that is compared, whatever class
//                 declares the keys. Two references to different instances may therefore count as equal.
//
// A pair of references is compared only if the instances that hold them have the same key and neither is null. Usually one of the
// two is the reference's. If that lacks the key, the instances of the others are compared with one another (see
// TDifferenceReader.cpp).
#include "client/comparison/DescribeExcludedKeys.h"

#include <algorithm>
#include <iterator>
#include <set>
#include <unordered_map>

#include "client/comparison/TInstanceIndex.h"
#include "client/inventory/CollectObjects.h"
#include "client/inventory/PropertyValue.h"
#include "embedded/store/TInMemInstance.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

using TInstances = TInstanceIndex::TInstances;

// Gathers over the inventories what becomes part of the coverage of one class.
class TExcludedKeys {
  public:
    TExcludedKeys(TCoverage::TClass& cls, TRules& rules) : fClass(cls), fRules(rules) {}

    void Describe(const std::vector<TInventory>& inventories, const std::vector<std::string>& compared)
    {
        FindIgnoredKeys(inventories);
        TInstanceIndex reference(*inventories[0].ns, fClass.name, fRules);
        reference.ForEachKey(
            [this](const std::string&, const TInstances& instances) { fClass.sharing[0] += instances.size() - 1; });
        for (std::size_t i = 1; i < inventories.size(); ++i) {
            FindReferences({inventories[0].ns, inventories[i].ns}, compared);
            const TInstanceIndex other(*inventories[i].ns, fClass.name, fRules);
            other.ForEachKey(
                [&](const std::string& key, const TInstances& instances) { Describe(i, key, instances, reference.Find(key)); });
        }
        for (const auto& [key, instances] : fAlone) {
            MatchReferencesAmong(instances, compared);
        }
        Keep(fKeysInReferences, fClass.referenceKeys);
    }

  private:
    void FindIgnoredKeys(const std::vector<TInventory>& inventories)
    {
        std::set<std::string> keys;
        for (const TInventory& inventory : inventories) {
            if (const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(fClass.name)) {
                const std::vector<std::string> names = KeyNamesOf(*cls);
                std::copy_if(names.begin(), names.end(), std::inserter(keys, keys.end()),
                             [this](const std::string& name) { return fRules.ExcludesKey(fClass.name, name); });
            }
        }
        Keep(keys, fClass.ignoredKeys);
    }

    // With --strict-schema an inventory may lack a property, or declare it with another type; the run then fails.
    void FindReferences(const std::vector<boost::shared_ptr<TInMemNamespace>>& pair, const std::vector<std::string>& compared)
    {
        fReferences = compared;
        for (const boost::shared_ptr<TInMemNamespace>& ns : pair) {
            const boost::shared_ptr<TInMemClass> cls = ns->FindClass(fClass.name);
            fReferences.erase(std::remove_if(fReferences.begin(), fReferences.end(),
                                             [&cls](const std::string& name) { return !cls || !IsReference(*cls, name); }),
                              fReferences.end());
        }
    }

    static bool IsReference(const TInMemClass& cls, const std::string& property)
    {
        const boost::shared_ptr<TInMemPropertyDecl> decl = cls.FindPropertyDecl(property);
        return decl && decl->GetType() == TCIMValue::TCIMType::kReference;
    }

    // The instances of one inventory that have the key, and those of the reference.
    void Describe(std::size_t inventory, const std::string& key, const TInstances& instances, const TInstances& masters)
    {
        const std::size_t sharing = instances.size() - 1;
        fClass.sharing[inventory] += sharing;
        if (masters.empty()) {
            fClass.sharingAlone[inventory] += sharing;
            TInstances& alone = fAlone[key];
            alone.insert(alone.end(), instances.begin(), instances.end());
            return;
        }
        for (std::size_t i = 0; i < instances.size() && !fReferences.empty(); ++i) {
            MatchReferences(*instances[i], *masters.front());
        }
    }

    void MatchReferences(const ICIMInstance& other, const ICIMInstance& master)
    {
        for (const std::string& property : fReferences) {
            const TCIMValue ofOther = ValueOf(other, property);
            const TCIMValue ofMaster = ValueOf(master, property);
            if (!ofOther.IsNull() && !ofMaster.IsNull()) {
                NoteLeftOut(ofOther);
                NoteLeftOut(ofMaster);
            }
        }
    }

    void MatchReferencesAmong(const TInstances& instances, const std::vector<std::string>& compared)
    {
        for (std::size_t i = 0; instances.size() > 1 && i < compared.size(); ++i) {
            std::vector<TCIMValue> references;
            for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
                const auto& stored = static_cast<const TInMemInstance&>(*instance);  // the client's inventories are in memory
                if (IsReference(*stored.GetInMemClass(), compared[i]) && !ValueOf(stored, compared[i]).IsNull()) {
                    references.push_back(ValueOf(stored, compared[i]));
                }
            }
            for (std::size_t reference = 0; references.size() > 1 && reference < references.size(); ++reference) {
                NoteLeftOut(references[reference]);
            }
        }
    }

    void NoteLeftOut(const TCIMReference& path)
    {
        const bool hasPlace = !path.GetNamespaceName().empty() || !path.GetHost().empty();
        fClass.reducedReferences = fClass.reducedReferences || hasPlace;
        path.EnumerateKeyBindings([this](const std::pair<std::string, TCIMValue>& binding) {
            if (fRules.ExcludesKey(fClass.name, binding.first)) {
                fClass.reducedReferences = true;
                fKeysInReferences.insert(binding.first);
            }
            return true;
        });
    }

    // The excluded keys that are among `names`, each once, in the order of the rules.
    void Keep(const std::set<std::string>& names, std::vector<std::string>& kept) const
    {
        for (const std::string& key : fClass.excludedKeys) {
            if (names.count(key) > 0 && std::find(kept.begin(), kept.end(), key) == kept.end()) {
                kept.push_back(key);
            }
        }
    }

    TCoverage::TClass& fClass;
    TRules& fRules;
    std::vector<std::string> fReferences;     // the reference properties compared between two inventories
    std::set<std::string> fKeysInReferences;  // the excluded keys met in references
    // The instances of the others whose key the reference lacks, by that key.
    std::unordered_map<std::string, TInstances> fAlone;
};

}  // namespace

void DescribeExcludedKeys(TCoverage::TClass& cls, const std::vector<TInventory>& inventories, TRules& rules,
                          const std::vector<std::string>& compared)
{
    cls.excludedKeys = rules.ExcludedKeysOf(cls.name);
    if (!cls.excludedKeys.empty()) {
        TExcludedKeys(cls, rules).Describe(inventories, compared);
    }
}

}  // namespace NORVZEL20

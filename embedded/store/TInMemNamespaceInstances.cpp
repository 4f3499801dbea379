// Finding, changing and removing instances by path.
//
// Only the class and the keys of the path count. Its key values are converted to the declared types first, because a path that was
// read from text has types that are only guessed. The extent of the class then finds the instance by its keys.
//
// A reference among the keys, or an embedded object, may still be written in another way than the one that the store has: with the
// own namespace, with names in another letter case, with keys as text. Only if nothing is found, such keys are adapted as they are
// at a load, and looked for again. So what was stored as it is, without a load, is found as it is.

#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/store/TStoreRefusal.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

TCIMValue GetKey(const TCIMReference& path, const TInMemPropertyDecl& decl)
{
    const TCIMValue* const bound = path.FindKeyValue(decl.GetName());
    if (!bound) {
        throw TStoreRefusal(TZELStatusCode::kKeyMissing,
                            [&] { return "key " + decl.GetName() + " of path " + TStoreRefusal::Shown(path); });
    }
    TCIMValue key;
    if (!TValueText::ConvertKey(*bound, decl.GetType(), key)) {
        throw TStoreRefusal(TZELStatusCode::kTypeMismatch, [&] {
            return "key " + decl.GetName() + " of path " + TStoreRefusal::Shown(path) + " is no " +
                   TValueText::DescribeType(decl.GetType());
        });
    }
    return key;
}

}  // namespace

boost::shared_ptr<TInMemInstance> TInMemNamespace::FindInstance(const TCIMReference& path) const
{
    const auto cls = FindClass(path.GetClassName());
    if (!cls) {
        return nullptr;
    }
    const TInMemLayout& layout = cls->GetLayout();
    std::vector<TCIMValue> keys;
    keys.reserve(layout.GetKeys().size());
    for (const std::uint32_t slot : layout.GetKeys()) {
        keys.push_back(GetKey(path, layout.GetDecl(slot)));
    }
    // A path with more keys than the class names no instance.
    if (path.GetKeyCount() != keys.size()) {
        return nullptr;
    }
    boost::shared_ptr<TInMemInstance> found = cls->GetExtent().Find(keys);
    return found || !AdaptKeys(layout, keys) ? found : cls->GetExtent().Find(keys);
}

/// Brings references and embedded objects among the keys in the form that they have after a load. Returns whether any changed.
bool TInMemNamespace::AdaptKeys(const TInMemLayout& layout, std::vector<TCIMValue>& keys) const
{
    const TReferenceAdapter adapter(*this, fOwnPlace);
    bool isChanged = false;
    for (std::size_t i = 0; i < keys.size(); ++i) {
        TCIMValue read;
        if (adapter.ConvertKey(layout.GetDecl(layout.GetKeys()[i]), keys[i], read)) {
            keys[i] = read;
            isChanged = true;
        }
        isChanged = adapter.Adapt(keys[i]) || isChanged;
    }
    return isChanged;
}

boost::shared_ptr<TInMemInstance> TInMemNamespace::RequireInstance(const TCIMReference& path) const
{
    auto instance = FindInstance(path);
    if (!instance) {
        throw TStoreRefusal(TZELStatusCode::kNotFound, [&] { return "instance " + TStoreRefusal::Shown(path); });
    }
    return instance;
}

boost::shared_ptr<ICIMInstance> TInMemNamespace::GetInstance(const TCIMReference& path, TCallContext) const
{
    return RequireInstance(path);
}

void TInMemNamespace::DeleteInstance(const TCIMReference& path, TCallContext)
{
    const auto instance = RequireInstance(path);
    instance->GetInMemClass()->GetExtent().Remove(*instance);
}

void TInMemNamespace::ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext)
{
    const auto instance = RequireInstance(path);
    const TInMemLayout& layout = instance->GetInMemClass()->GetLayout();
    std::vector<std::pair<std::uint32_t, TCIMValue>> changes;
    for (const auto& [name, value] : properties) {
        const std::uint32_t slot = layout.FindSlot(name);
        if (slot == TInMemLayout::kNoSlot) {
            throw TStoreRefusal(TZELStatusCode::kNotFound, [&, &wanted = name] {
                return "property " + wanted + " of instance " + TStoreRefusal::Shown(path);
            });
        }
        TCIMValue fitting = layout.GetDecl(slot).Fit(value, instance.get());
        // A key may be named, but only with the value that it has.
        if (!layout.GetDecl(slot).IsKey()) {
            changes.emplace_back(slot, std::move(fitting));
        } else if (!instance->GetSlotValue(slot).IsSameKey(fitting)) {
            throw TStoreRefusal(TZELStatusCode::kInvalidParameter, [&, &wanted = name] {
                return "another value for key " + wanted + " of instance " + TStoreRefusal::Shown(path);
            });
        }
    }
    // All values fit; only now is the first one set.
    for (auto& [slot, value] : changes) {
        instance->SetSlot(slot, std::move(value));
    }
}

void TInMemNamespace::ClearInstances()
{
    for (auto& [name, entry] : fClassesByName) {
        entry.extent->Clear();
    }
}

}  // namespace NORVZEL20

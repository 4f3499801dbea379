// What to do with instances that come before something they need.
//
// 1. The class of the instance itself is not declared yet. Its properties have no types and no slots, so it waits as a draft until
//    the document ends. All instances after it wait too; otherwise they would overtake it, and the namespace would not keep the
//    document's order.
// 2. The class is known, but a reference is to a class that is not, or whether it stays in the document's own namespace is open.
//    How a reference is written depends on both, so it is noted and written again at the end. The instance is added meanwhile.
// 3. As 2, but the reference is a key. Then the name of the instance itself may change, so the instance is held: filled, but added
//    only after its references have been written again. Later instances of its class are held too, for the order.
#include "embedded/load/TLateInstances.h"

#include <algorithm>
#include <unordered_set>

#include "embedded/load/DropPlaces.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/value/ChangeReferences.h"
#include "host/TCIMReference.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

void VisitClasses(TCIMValue value, const boost::function<void(const std::string&)>& visit)
{
    ChangeReferences(value, [&](TCIMValue& reference) {
        const TCIMReference path = reference;
        visit(path.GetClassName());
        path.EnumerateKeyBindings([&](const std::pair<std::string, TCIMValue>& key) {
            VisitClasses(key.second, visit);
            return true;
        });
        return false;
    });
}

bool HasInstance(const TInMemNamespace& ns, const TCIMReference& path)
{
    TCIMReference local(path);
    local.SetNamespaceName("");
    local.SetHost("");
    try {
        return ns.FindInstance(local) != nullptr;
    } catch (const TZELException&) {
        return false;  // its keys are not those of the class, so it leads nowhere here
    }
}

struct TPathHash {
    std::size_t operator()(const TCIMValue& path) const { return static_cast<std::size_t>(path.KeyHash()); }
};
struct TSamePath {
    bool operator()(const TCIMValue& a, const TCIMValue& b) const { return a.IsSameKey(b); }
};
using TPaths = std::unordered_set<TCIMValue, TPathHash, TSamePath>;

// The references in their keys may be open, so they are compared without places.
TPaths LocalPathsOf(const std::vector<TLateInstances::THeld>& held)
{
    TPaths paths;
    for (const TLateInstances::THeld& one : held) {
        TCIMValue path(one.instance->GetReference());
        DropPlaces(path);
        paths.insert(std::move(path));
    }
    return paths;
}

}  // namespace

void TLateInstances::ForEachClass(const boost::function<void(const std::string&)>& visit) const
{
    for (const TDraft& draft : fDrafts) {
        visit(draft.object.GetClassName());
        for (const TEmbeddedObject::TProperty& property : draft.object.GetProperties()) {
            VisitClasses(property.value, visit);
        }
        for (const auto& key : draft.ownKeys) {
            VisitClasses(key.second, visit);
        }
    }
    for (const auto& [instance, slot] : fReferences) {
        VisitClasses(instance->GetSlotValue(slot), visit);
    }
}

void TLateInstances::AdaptReferences(TOwnPlaceSearch& place, const TInMemNamespace& ns, std::size_t declared)
{
    if (declared == fDeclaredBefore) {
        return;  // what was not known then is not known now
    }
    const TReferenceAdapter adapter(ns);
    for (const auto& [instance, slot] : fReferences) {
        TCIMValue value = instance->GetSlotValue(slot);
        if (adapter.Adapt(value)) {
            place.MakeLocal(value);  // a key that was text may be a reference now
            instance->SetSlot(slot, std::move(value));
        }
    }
}

bool TLateInstances::LeadTo(const TInMemNamespace& ns) const
{
    const TPaths held = LocalPathsOf(fHeld);
    const auto leads = [&](const TCIMReference& path) {
        TCIMValue local(path);
        DropPlaces(local);
        return !path.GetNamespaceName().empty() && (HasInstance(ns, path) || held.count(local) > 0);
    };
    return std::any_of(fReferences.begin(), fReferences.end(), [&leads](const auto& noted) {
        TCIMValue value = noted.first->GetSlotValue(noted.second);
        bool isFound = false;
        ChangeReferences(value, [&](TCIMValue& reference) {
            isFound = isFound || leads(reference);
            return false;
        });
        return isFound;
    });
}

void TLateInstances::MakeReferencesLocal(TOwnPlaceSearch& place)
{
    if (!place.HasOpen()) {
        return;
    }
    for (const auto& [instance, slot] : std::exchange(fReferences, {})) {
        TCIMValue value = instance->GetSlotValue(slot);
        place.MakeLocal(value);
        instance->SetSlot(slot, std::move(value));
    }
}

}  // namespace NORVZEL20

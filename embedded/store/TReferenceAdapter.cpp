// Bringing references in line with the classes that they name.
//
// A reference holds its class and its keys. One that was read before its class was declared holds a stub of the class, and keys
// typed as the text suggests: "5" may be a uint64 or a sint8. When the class is there, the reference is made anew, with the class
// itself and with keys of the declared spelling and type. A key may be a reference, so this goes on inside; arrays and the
// properties of embedded objects are searched too. A value in which nothing changes is not copied.
//
// A key that was text may turn out to be a reference only now, or an embedded object. It then has to look as if it had been one
// from the start: without the own namespace (TOwnPlace), and with text again in the place of what nests too deeply
// (TValueAccess::LimitDepth). That text is the one that a reference would have in the path, so it does not matter in which steps
// the references were made.
//
// If a reference that is a key, or in an embedded object that is one, changes, its instance has another path. The index of the
// extent is renewed afterwards, and two instances may turn out to have one path, if their keys differed in nothing but the spelling
// of a name.

#include "embedded/store/TReferenceAdapter.h"

#include "embedded/store/FindDuplicate.h"
#include "embedded/value/ChangeReferences.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TAccess = TValueAccess;
using TType = TCIMValue::TCIMType;
using TKeys = std::vector<std::pair<std::string, TCIMValue>>;

TKeys GetKeys(const TCIMReference& path)
{
    TKeys keys;
    path.EnumerateKeyBindings([&keys](std::pair<std::string, TCIMValue> key) {
        keys.push_back(std::move(key));
        return true;
    });
    return keys;
}

/// A path with the namespace and host of `like`.
TCIMReference MakePath(const TCIMReference& like, const boost::shared_ptr<ICIMClass>& cls, const TKeys& keys)
{
    TCIMReference path(like.GetNamespace(), std::map<std::string, TCIMValue>());
    // The namespace may be gone or unknown; its name stays in the path.
    if (path.GetNamespaceName() != like.GetNamespaceName()) {
        path.SetNamespaceName(like.GetNamespaceName());
    }
    if (!like.GetHost().empty()) {
        path.SetHost(like.GetHost());
    }
    path.SetClass(cls);
    for (const auto& [name, value] : keys) {
        path.AddKeyValue(name, value);
    }
    return path;
}

/// The slots whose values may hold references, in embedded objects too.
std::vector<std::uint32_t> FindSlotsToAdapt(const TInMemClass& cls)
{
    std::vector<std::uint32_t> slots;
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        const TInMemPropertyDecl& decl = cls.GetLayout().GetDecl(slot);
        const TType::ECIMType type = decl.GetType().GetElementType();
        if (!decl.IsStatic() && (type == TType::kReference || type == TType::kString)) {
            slots.push_back(slot);
        }
    }
    return slots;
}

}  // namespace

const TInMemPropertyDecl* TReferenceAdapter::AdaptKey(const TInMemClass& cls, std::string& name, TCIMValue& value) const
{
    const std::uint32_t slot = cls.GetLayout().FindSlot(name);
    if (slot == TInMemLayout::kNoSlot) {
        return nullptr;
    }
    const TInMemPropertyDecl& decl = cls.GetLayout().GetDecl(slot);
    name = decl.GetName();
    AdaptKeyValue(decl, value);
    return &decl;
}

/// Most keys are of the declared type already, and plain text; for those it looks no further than the first character.
bool TReferenceAdapter::ConvertKey(const TInMemPropertyDecl& decl, const TCIMValue& value, TCIMValue& converted) const
{
    if (value.GetType() != decl.GetType()) {
        return TValueText::ConvertKey(value, decl.GetType(), converted);
    }
    if (!TAccess::IsText(value) || !TEmbeddedObject::IsPerhapsText(TAccess::GetText(value)) || !decl.HoldsObjects()) {
        return false;
    }
    converted = fNamespace.ReadObject(value, fEmbeddedDepth);
    return !TAccess::IsText(converted);
}

bool TReferenceAdapter::AdaptKeyValue(const TInMemPropertyDecl& decl, TCIMValue& value) const
{
    TCIMValue adapted;
    if (!ConvertKey(decl, value, adapted)) {
        return false;
    }
    Adapt(adapted);  // text may have become a reference, or an object with references
    TAccess::LimitDepth(adapted, kLevelsAbove);
    // What nests too deeply is text again.
    const bool isChanged = TAccess::GetForm(adapted) != TAccess::GetForm(value) || adapted != value;
    value = adapted;
    return isChanged;
}

bool TReferenceAdapter::Adapt(TCIMValue& value) const
{
    return ChangeReferences(value, [this](TCIMValue& path) { return AdaptPath(path); });
}

bool TReferenceAdapter::AdaptPath(TCIMValue& value) const
{
    const TCIMReference path = value;
    const boost::shared_ptr<TInMemClass> cls = fNamespace.FindClass(path.GetClassName());
    const bool namesOwnPlace = fOwnPlace != nullptr && fOwnPlace->IsNamedBy(path);
    bool isChanged = namesOwnPlace || (cls && path.GetClass() != cls);
    TKeys keys = GetKeys(path);
    for (auto& [name, key] : keys) {
        isChanged = AdaptBinding(cls.get(), name, key) || isChanged;
    }
    if (!isChanged) {
        return false;
    }
    TCIMReference adapted = MakePath(path, cls ? boost::shared_ptr<ICIMClass>(cls) : path.GetClass(), keys);
    if (namesOwnPlace) {
        adapted.SetNamespaceName("");
        adapted.SetHost("");
    }
    value = TCIMValue(adapted);
    return true;
}

/// `cls` is null if the class of the path is not declared. Returns whether name or value changed.
bool TReferenceAdapter::AdaptBinding(const TInMemClass* cls, std::string& name, TCIMValue& value) const
{
    bool isChanged = Adapt(value);
    if (isChanged) {
        TAccess::LimitDepth(value, kLevelsAbove);
    }
    const std::uint32_t slot = cls != nullptr ? cls->GetLayout().FindSlot(name) : TInMemLayout::kNoSlot;
    if (slot == TInMemLayout::kNoSlot) {
        return isChanged;
    }
    const TInMemPropertyDecl& decl = cls->GetLayout().GetDecl(slot);
    isChanged = AdaptKeyValue(decl, value) || isChanged || name != decl.GetName();
    name = decl.GetName();
    return isChanged;
}

void TReferenceAdapter::AdaptStatics(const TInMemClass& cls) const
{
    // Inherited static values are adapted with the class that declares them.
    for (const boost::shared_ptr<TInMemPropertyDecl>& decl : cls.GetLayout().GetOwnDecls()) {
        TCIMValue value = decl->GetStaticProperty().GetValue();
        if (decl->IsStatic() && Adapt(value)) {
            decl->GetStaticProperty().SetValue(value);
        }
    }
}

/// Returns whether a key changed.
bool TReferenceAdapter::AdaptInstance(TInMemInstance& instance, const std::vector<std::uint32_t>& slots) const
{
    bool isKeyChanged = false;
    for (const std::uint32_t slot : slots) {
        const TCIMValue& stored = instance.GetSlotValue(slot);
        // Most strings are plain text, in which there is nothing to adapt.
        if (TAccess::IsText(stored) || stored.IsNull()) {
            continue;
        }
        TCIMValue value = stored;
        if (Adapt(value)) {
            instance.GetSlotProperty(slot).Rewrite(std::move(value));
            isKeyChanged = isKeyChanged || instance.GetInMemClass()->GetLayout().GetDecl(slot).IsKey();
        }
    }
    return isKeyChanged;
}

/// Returns whether a key of any instance changed.
bool TReferenceAdapter::AdaptInstances(TInMemClass& cls) const
{
    const std::vector<std::uint32_t> slots = FindSlotsToAdapt(cls);
    bool isKeyChanged = false;
    cls.EnumerateInstances(
        [&](const boost::shared_ptr<ICIMInstance>& instance) {
            // An in-memory class has in-memory instances only.
            isKeyChanged = AdaptInstance(static_cast<TInMemInstance&>(*instance), slots) || isKeyChanged;
            return true;
        },
        false, TCallContext());
    return isKeyChanged;
}

std::string TReferenceAdapter::AdaptAndFindDuplicate(TInMemNamespace& ns)
{
    const TReferenceAdapter adapter(ns, ns.GetOwnPlace());
    std::vector<boost::shared_ptr<TInMemClass>> withChangedKeys;
    for (const boost::shared_ptr<TInMemClass>& cls : ns.GetClasses()) {
        adapter.AdaptStatics(*cls);
        if (adapter.AdaptInstances(*cls)) {
            withChangedKeys.push_back(cls);
        }
    }
    if (!withChangedKeys.empty()) {
        ns.ReferenceTextsChanged();
    }
    for (const boost::shared_ptr<TInMemClass>& cls : withChangedKeys) {
        std::string duplicate = FindDuplicate(*cls);
        if (!duplicate.empty()) {
            return duplicate;
        }
    }
    return std::string();
}

}  // namespace NORVZEL20

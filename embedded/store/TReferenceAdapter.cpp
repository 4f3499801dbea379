#include "embedded/store/TReferenceAdapter.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <unordered_set>

#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TAccess = TValueAccess;
using TType = TCIMValue::TCIMType;
using TKeys = std::vector<std::pair<std::string, TCIMValue>>;

TKeys KeysOf(const TCIMReference& path)
{
    TKeys keys;
    path.EnumerateKeyBindings([&keys](std::pair<std::string, TCIMValue> key) {
        keys.push_back(std::move(key));
        return true;
    });
    return keys;
}

TCIMReference MakePath(const TCIMReference& like, const boost::shared_ptr<ICIMClass>& cls, const TKeys& keys)
{
    TCIMReference path(like.GetNamespace(), std::map<std::string, TCIMValue>());
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
std::vector<std::uint32_t> SlotsToAdapt(const TInMemClass& cls)
{
    std::vector<std::uint32_t> slots;
    for (const std::uint32_t slot : cls.GetSlotOrder()) {
        const TInMemPropertyDecl& decl = cls.GetSlotDecl(slot);
        const TType::ECIMType type = decl.GetType().GetElementType();
        if (decl.IsStatic()) {
            continue;
        }
        if (type == TType::kReference || (type == TType::kString && !decl.IsKey())) {
            slots.push_back(slot);
        }
    }
    return slots;
}

std::string FindDouble(TInMemClass& cls)
{
    std::unordered_set<std::string> paths;
    std::string twice;
    cls.EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> instance) {
            std::string path = instance->GetReference(TCallContext()).GetPath();
            if (!paths.insert(path).second) {
                twice = std::move(path);
            }
            return twice.empty();
        },
        false, TCallContext());
    return twice;
}

}  // namespace

const TInMemPropertyDecl* TReferenceAdapter::AdaptKey(const TInMemClass& cls, std::string& name, TCIMValue& value)
{
    const std::uint32_t slot = cls.FindSlot(name);
    if (slot == TInMemClass::kNoSlot) {
        return nullptr;
    }
    const TInMemPropertyDecl& decl = cls.GetSlotDecl(slot);
    name = decl.GetName();
    TCIMValue adapted;
    if (value.GetType() != decl.GetType() && TValueText::Convert(value, decl.GetType(), adapted)) {
        value = adapted;
    }
    return &decl;
}

bool TReferenceAdapter::Adapt(TCIMValue& value) const
{
    switch (TAccess::GetForm(value)) {
    case TAccess::kPath:
        return AdaptPath(value);
    case TAccess::kArray:
    case TAccess::kBag:
        return AdaptElements(value);
    case TAccess::kObject:
        return AdaptObject(value);
    default:
        return false;
    }
}

bool TReferenceAdapter::AdaptPath(TCIMValue& value) const
{
    const TCIMReference path = value;
    const boost::shared_ptr<TInMemClass> cls = fNamespace.FindClass(path.GetClassName());
    bool isOther = cls && path.GetClass() != cls;
    TKeys keys = KeysOf(path);
    for (auto& [name, key] : keys) {
        isOther = Adapt(key) || isOther;
        if (!cls) {
            continue;
        }
        const std::string nameBefore = name;
        const TCIMValue::TCIMType typeBefore = key.GetType();
        AdaptKey(*cls, name, key);
        isOther = isOther || name != nameBefore || key.GetType() != typeBefore;
    }
    if (isOther) {
        value = TCIMValue(MakePath(path, cls ? boost::shared_ptr<ICIMClass>(cls) : path.GetClass(), keys));
    }
    return isOther;
}

bool TReferenceAdapter::AdaptElements(TCIMValue& value) const
{
    const auto mayRefer = [](const TCIMValue& element) {
        return TAccess::GetForm(element) == TAccess::kPath || TAccess::GetForm(element) == TAccess::kObject;
    };
    const std::vector<TCIMValue>& stored = value.GetElements();
    if (std::none_of(stored.begin(), stored.end(), mayRefer)) {
        return false;
    }
    bool isOther = false;
    std::vector<TCIMValue> elements = stored;
    for (TCIMValue& element : elements) {
        isOther = Adapt(element) || isOther;
    }
    if (isOther) {
        const TCIMValue adapted(value.GetType(), static_cast<unsigned int>(elements.size()), elements);
        value = value.IsBag() ? adapted.AsBag() : adapted;
    }
    return isOther;
}

bool TReferenceAdapter::AdaptObject(TCIMValue& value) const
{
    const boost::shared_ptr<const TEmbeddedObject> object = value.GetEmbeddedObject();
    std::vector<TEmbeddedObject::TProperty> properties = object->GetProperties();
    bool isOther = false;
    for (TEmbeddedObject::TProperty& property : properties) {
        isOther = Adapt(property.fValue) || isOther;
    }
    if (!isOther) {
        return false;
    }
    const auto adapted = boost::make_shared<TEmbeddedObject>(object->GetClassName(), object->IsClass());
    adapted->SetSuperClassName(object->GetSuperClassName());
    for (const TEmbeddedObject::TQualifier& qualifier : object->GetQualifiers()) {
        adapted->AddQualifier(qualifier);
    }
    for (TEmbeddedObject::TProperty& property : properties) {
        adapted->AddProperty(std::move(property));
    }
    for (const TEmbeddedObject::TMethod& method : object->GetMethods()) {
        adapted->AddMethod(method);
    }
    value = TCIMValue(boost::shared_ptr<const TEmbeddedObject>(adapted));
    return true;
}

/// Returns whether a key changed.
bool TReferenceAdapter::AdaptInstance(TInMemInstance& instance, const std::vector<std::uint32_t>& slots) const
{
    bool isKeyOther = false;
    for (const std::uint32_t slot : slots) {
        const TCIMValue& stored = instance.GetSlotValue(slot);
        if (TAccess::IsText(stored) || stored.IsNull()) {
            continue;
        }
        TCIMValue value = stored;
        if (Adapt(value)) {
            instance.Rewrite(slot, std::move(value));
            isKeyOther = isKeyOther || instance.GetInMemClass()->GetSlotDecl(slot).IsKey();
        }
    }
    return isKeyOther;
}

void TReferenceAdapter::AdaptStatics(const TInMemClass& cls) const
{
    for (const boost::shared_ptr<TInMemPropertyDecl>& decl : cls.GetOwnPropertyDecls()) {
        TCIMValue value = decl->GetStaticProperty().GetValue();
        if (decl->IsStatic() && Adapt(value)) {
            decl->GetStaticProperty().SetValue(value);
        }
    }
}

std::string TReferenceAdapter::AdaptAll(TInMemNamespace& ns)
{
    const TReferenceAdapter adapter(ns);
    std::vector<boost::shared_ptr<TInMemClass>> withOtherKeys;
    for (const boost::shared_ptr<TInMemClass>& cls : ns.GetClasses()) {
        adapter.AdaptStatics(*cls);
        const std::vector<std::uint32_t> slots = SlotsToAdapt(*cls);
        bool isKeyOther = false;
        cls->EnumerateInstances(
            [&](const boost::shared_ptr<ICIMInstance>& instance) {
                // The classes of this namespace have instances of this kind alone.
                isKeyOther = adapter.AdaptInstance(static_cast<TInMemInstance&>(*instance), slots) || isKeyOther;
                return true;
            },
            false, TCallContext());
        if (isKeyOther) {
            withOtherKeys.push_back(cls);
        }
    }
    std::string twice;
    if (!withOtherKeys.empty()) {
        ns.ReferenceTextsChanged();
    }
    for (std::size_t at = 0; at < withOtherKeys.size() && twice.empty(); ++at) {
        twice = FindDouble(*withOtherKeys[at]);
    }
    return twice;
}

}  // namespace NORVZEL20

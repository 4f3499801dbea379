#include "client/OperatingSystem.h"

#include <algorithm>

#include "client/CimWalk.h"
#include "embedded/TSchemaCopier.h"
#include "host/TCIMDateTime.h"

namespace NORVZEL20 {

const char* const kOperatingSystemClass = "KALMO_OperatingSystem";

namespace {

const char kStandardClass[] = "CIM_OperatingSystem";
const char kTypeProperty[] = "OSType";
const char kNameProperty[] = "Name";
const char kKeyQualifier[] = "Key";

// What the new instance tells about the system.
struct TSystem {
    TCIMValue name = TCIMValue("unknown");
    std::uint64_t type = 0;
};

TCIMValue FindValue(const ICIMInstance& instance, const char* property)
{
    return FindPropertyDecl(*instance.GetClass(TCallContext()), property)
               ? instance.GetProperty(property, TCallContext())->GetValue(TCallContext())
               : TCIMValue();
}

// Of several instances the one whose path comes first, so that the order in the file does not matter.
boost::shared_ptr<ICIMInstance> FindStandardInstance(TInMemNamespace& ns)
{
    boost::shared_ptr<ICIMInstance> first;
    if (const boost::shared_ptr<TInMemClass> cls = ns.FindClass(kStandardClass)) {
        std::string firstPath;
        cls->EnumerateInstances(
            [&](boost::shared_ptr<ICIMInstance> instance) {
                const std::string path = instance->GetReference(TCallContext()).GetPath();
                if (!first || path < firstPath) {
                    first = instance;
                    firstPath = path;
                }
                return true;
            },
            true, TCallContext());
    }
    return first;
}

TSystem Describe(TInMemNamespace& ns)
{
    TSystem system;
    const boost::shared_ptr<ICIMInstance> instance = FindStandardInstance(ns);
    if (!instance) {
        return system;
    }
    const TCIMValue name = FindValue(*instance, kNameProperty);
    if (!name.IsNull() && name.GetType() == TCIMValue::TCIMType::kString) {
        system.name = name;
    }
    const TCIMValue type = FindValue(*instance, kTypeProperty);
    if (!type.IsNull() && type.GetType() == TCIMValue::TCIMType::kUint16) {
        system.type = type.GetUnsigned();
    }
    return system;
}

void AddProperty(TInMemNamespace& ns, TInMemClass& cls, const char* name, TCIMValue::TCIMType type, bool isKey)
{
    const boost::shared_ptr<ICIMPropertyDecl> decl = cls.AllocatePropertyDecl(name, TCIMValue::Null(type), TCallContext());
    if (isKey) {
        if (!ns.FindQualifierDecl(kKeyQualifier)) {
            ns.AllocateQualifierDecl(
                kKeyQualifier, TCIMValue(false),
                ICIMQualifierDecl::EScope(ICIMQualifierDecl::kScopeProperty | ICIMQualifierDecl::kScopeReference),
                ICIMQualifierDecl::kFlavorToSubclass, TCallContext());
        }
        const boost::shared_ptr<const ICIMQualifierDecl> key = ns.FindQualifierDecl(kKeyQualifier);
        decl->AddQualifier(decl->AllocateQualifier(key, TCIMValue(true), TCallContext()), TCallContext());
    }
    cls.AddPropertyDecl(decl);
}

boost::shared_ptr<TInMemClass> DeclareClass(const std::vector<TInventory>& inventories, const TInventory& inventory)
{
    for (const TInventory& other : inventories) {
        if (const boost::shared_ptr<TInMemClass> declared = other.ns->FindClass(kOperatingSystemClass)) {
            TSchemaCopier(inventory.ns).CopyClass(*declared);
            return inventory.ns->FindClass(kOperatingSystemClass);
        }
    }
    const boost::shared_ptr<TInMemClass> cls =
        inventory.ns->AllocateInMemClass(kOperatingSystemClass, boost::shared_ptr<TInMemClass>());
    cls->AddToNamespace(TCallContext());
    AddProperty(*inventory.ns, *cls, kNameProperty, TCIMValue::TCIMType::kString, true);
    return cls;
}

// A value that a key can have, for a class whose keys are another inventory's.
TCIMValue SomeValue(TCIMValue::TCIMType type, const std::string& className)
{
    switch (type) {
    case TCIMValue::TCIMType::kBoolean:
        return TCIMValue(false);
    case TCIMValue::TCIMType::kUint8:
        return TCIMValue(static_cast<unsigned char>(0));
    case TCIMValue::TCIMType::kSint8:
        return TCIMValue(static_cast<signed char>(0));
    case TCIMValue::TCIMType::kUint16:
        return TCIMValue(static_cast<unsigned short>(0));
    case TCIMValue::TCIMType::kSint16:
        return TCIMValue(static_cast<short>(0));
    case TCIMValue::TCIMType::kUint32:
        return TCIMValue(0u);
    case TCIMValue::TCIMType::kSint32:
        return TCIMValue(0);
    case TCIMValue::TCIMType::kUint64:
        return TCIMValue(0ul);
    case TCIMValue::TCIMType::kSint64:
        return TCIMValue(0l);
    case TCIMValue::TCIMType::kReal32:
        return TCIMValue(0.0f);
    case TCIMValue::TCIMType::kReal64:
        return TCIMValue(0.0);
    case TCIMValue::TCIMType::kChar16:
        return TCIMValue(u'?');
    case TCIMValue::TCIMType::kDateTime:
        return TCIMValue(TCIMDateTime());
    case TCIMValue::TCIMType::kReference: {
        TCIMReference path;
        path.SetClassName(className);
        return TCIMValue(path);
    }
    default:
        return TCIMValue("unknown");
    }
}

void AddInstance(TInMemNamespace& ns, TInMemClass& cls)
{
    if (!cls.FindPropertyDecl(kTypeProperty)) {
        AddProperty(ns, cls, kTypeProperty, TCIMValue::TCIMType::kUint16, false);
    }
    const TSystem system = Describe(ns);
    const boost::shared_ptr<TInMemInstance> instance = cls.AllocateInMemInstance();
    for (const std::uint32_t slot : cls.GetKeySlots()) {
        instance->SetSlot(slot, SomeValue(cls.GetSlotDecl(slot).GetType(), cls.GetName()));
    }
    const std::uint32_t name = cls.FindSlot(kNameProperty);
    if (name != TInMemClass::kNoSlot && cls.GetSlotDecl(name).GetType() == TCIMValue::TCIMType::kString) {
        instance->SetSlot(name, system.name);
    }
    const std::uint32_t type = cls.FindSlot(kTypeProperty);
    if (cls.GetSlotDecl(type).GetType() == TCIMValue::TCIMType::kUint16) {
        instance->SetSlot(type, TCIMValue(static_cast<unsigned short>(system.type)));
    }
    instance->AddToNamespace(TCallContext());
}

}  // namespace

std::vector<TSchemaNote> MakeMissingOperatingSystems(std::vector<TInventory>& inventories)
{
    std::vector<TSchemaNote> notes;
    for (std::size_t i = 0; i < inventories.size(); ++i) {
        TInMemNamespace& ns = *inventories[i].ns;
        boost::shared_ptr<TInMemClass> cls = ns.FindClass(kOperatingSystemClass);
        if (cls && cls->GetInstanceCount() > 0) {
            continue;
        }
        if (!cls) {
            cls = DeclareClass(inventories, inventories[i]);
        }
        AddInstance(ns, *cls);
        notes.push_back({TSchemaNote::kOperatingSystemMade, i, i, kOperatingSystemClass, std::string(), std::string()});
    }
    return notes;
}

}  // namespace NORVZEL20

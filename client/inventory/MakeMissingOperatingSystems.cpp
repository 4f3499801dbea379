// Why and how an operating system is made.
//
// The plug-in compares only namespaces that declare KALMO_OperatingSystem, and only if the reference has an instance whose OSType
// it can read. Few inventories have one, because it is not a standard class; so the client makes what is missing:
//   the class       as the first inventory that has it declares it; if none does, with the key Name alone
//   OSType          is added to the class if it lacks one
//   the instance    Name and OSType of the standard class's instance, as far as it has a text and an integer from 0 to 65535 there;
//                   OSType in the type that the class declares, if that is an integer type
//   other keys      any value of their type, because a key must not be null
// If the client also makes the rules, they exclude the class: what the client has made says nothing about the systems.
#include "client/inventory/MakeMissingOperatingSystems.h"

#include "client/inventory/FindDeclarations.h"
#include "client/inventory/PropertyValue.h"
#include "client/process/TClientError.h"
#include "embedded/store/TSchemaCopier.h"
#include "embedded/value/TTypeKind.h"
#include "embedded/value/TValueText.h"
#include "host/TCIMDateTime.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

const char kStandardClass[] = "CIM_OperatingSystem";
const char kNameProperty[] = "Name";
const char kKeyQualifier[] = "Key";

// What the new instance says about the system.
struct TSystem {
    TCIMValue name = TCIMValue("unknown");
    TCIMValue type = TCIMValue(static_cast<unsigned short>(0));
};

TCIMValue FindValue(const ICIMInstance& instance, const char* property)
{
    return FindPropertyDecl(*instance.GetClass(TCallContext()), property) ? ValueOf(instance, property) : TCIMValue();
}

// Of several instances the one with the smallest path: the order in the file has no influence.
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

TSystem ReadStandardInstance(TInMemNamespace& ns)
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
    const TCIMValue type = FindValue(*instance, kOperatingSystemType);
    if (!type.IsNull() && TTypeKind::IsInteger(type.GetType())) {
        TValueText::Convert(type, TCIMValue::TCIMType::kUint16, system.type);  // stays 0 if it is out of range
    }
    return system;
}

// The qualifier that marks keys. An inventory without declarations of qualifiers gets this one.
boost::shared_ptr<const ICIMQualifierDecl> RequireKeyQualifier(TInMemNamespace& ns)
{
    if (!ns.FindQualifierDecl(kKeyQualifier)) {
        ns.AllocateQualifierDecl(
            kKeyQualifier, TCIMValue(false),
            static_cast<ICIMQualifierDecl::EScope>(ICIMQualifierDecl::kScopeProperty | ICIMQualifierDecl::kScopeReference),
            ICIMQualifierDecl::kFlavorToSubclass, TCallContext());
    }
    return ns.FindQualifierDecl(kKeyQualifier);
}

void AddProperty(TInMemNamespace& ns, TInMemClass& cls, const char* name, TCIMValue::TCIMType type, bool isKey)
{
    const boost::shared_ptr<ICIMPropertyDecl> decl = cls.AllocatePropertyDecl(name, TCIMValue::Null(type), TCallContext());
    if (isKey) {
        decl->AddQualifier(decl->AllocateQualifier(RequireKeyQualifier(ns), TCIMValue(true), TCallContext()), TCallContext());
    }
    cls.AddPropertyDecl(decl);
}

[[noreturn]] void Refuse(const TInventory& inventory, const std::string& reason)
{
    throw TClientError(inventory.path + ": has no instance of " + kOperatingSystemClass +
                       ", which a comparison needs, and none can be made: " + reason + "; add one to the inventory");
}

// Why the class cannot be declared in `ns`: which property a superclass there declares with another type.
std::string DescribeConflict(const TInMemClass& declared, const TInMemNamespace& ns)
{
    for (const TInMemClass* cls = &declared; cls != nullptr; cls = cls->GetSuperInMemClass().get()) {
        const boost::shared_ptr<TInMemClass> super =
            cls->GetSuperInMemClass() ? ns.FindClass(cls->GetSuperInMemClass()->GetName()) : nullptr;
        for (const boost::shared_ptr<TInMemPropertyDecl>& own : cls->GetLayout().GetOwnDecls()) {
            const boost::shared_ptr<TInMemPropertyDecl> above = super ? super->FindPropertyDecl(own->GetName()) : nullptr;
            if (above && above->GetType() != own->GetType()) {
                return "property " + own->GetName() + " of " + cls->GetName() + " is " + TValueText::DescribeType(own->GetType()) +
                       " there, but " + super->GetName() + " declares it as " + TValueText::DescribeType(above->GetType()) +
                       " here";
            }
        }
    }
    return "the declarations do not fit together";
}

boost::shared_ptr<TInMemClass> DeclareAs(const TInventory& source, const TInMemClass& declared, const TInventory& inventory)
{
    try {
        // All or nothing: after a failure the inventory has none of the classes.
        TSchemaCopier(inventory.ns).CopyClass(declared);
    } catch (const TZELException&) {
        Refuse(inventory, "the class cannot be declared as in " + source.path + ", " + DescribeConflict(declared, *inventory.ns));
    }
    return inventory.ns->FindClass(kOperatingSystemClass);
}

boost::shared_ptr<TInMemClass> DeclareClass(const std::vector<TInventory>& inventories, const TInventory& inventory)
{
    for (const TInventory& other : inventories) {
        if (const boost::shared_ptr<TInMemClass> declared = other.ns->FindClass(kOperatingSystemClass)) {
            return DeclareAs(other, *declared, inventory);
        }
    }
    const boost::shared_ptr<TInMemClass> cls =
        inventory.ns->AllocateInMemClass(kOperatingSystemClass, boost::shared_ptr<TInMemClass>());
    cls->AddToNamespace(TCallContext());
    AddProperty(*inventory.ns, *cls, kNameProperty, TCIMValue::TCIMType::kString, true);
    return cls;
}

// Any value of the type, for a key about which nothing is known.
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

void AddTypeProperty(const TInventory& inventory, TInMemClass& cls)
{
    // A class below may already have OSType with another type; the store would refuse without naming it.
    for (const boost::shared_ptr<TInMemClass>& below : cls.GetClassesBelow()) {
        const boost::shared_ptr<TInMemPropertyDecl> other = below->FindPropertyDecl(kOperatingSystemType);
        if (other && other->GetType() != TCIMValue::TCIMType::kUint16) {
            Refuse(inventory, "property " + other->GetName() + " of " + below->GetName() + " is " +
                                  TValueText::DescribeType(other->GetType()) + " instead of uint16");
        }
    }
    AddProperty(*inventory.ns, cls, kOperatingSystemType, TCIMValue::TCIMType::kUint16, false);
}

// A type that is no integer cannot hold any OSType. If the inventory is the reference, the run reports that.
void SetType(TInMemInstance& instance, const TCIMValue& type)
{
    const TInMemLayout& layout = instance.GetInMemClass()->GetLayout();
    const std::uint32_t slot = layout.FindSlot(kOperatingSystemType);
    const TCIMValue::TCIMType declared = layout.GetDecl(slot).GetType();
    if (TTypeKind::IsInteger(declared)) {
        TCIMValue fitting = SomeValue(declared, std::string());
        TValueText::Convert(type, declared, fitting);  // stays 0 if the declared type cannot hold it
        instance.SetSlot(slot, fitting);
    }
}

void AddInstance(const TInventory& inventory, TInMemClass& cls)
{
    TInMemNamespace& ns = *inventory.ns;
    if (!cls.FindPropertyDecl(kOperatingSystemType)) {
        AddTypeProperty(inventory, cls);
    }
    const TSystem system = ReadStandardInstance(ns);
    const boost::shared_ptr<TInMemInstance> instance = cls.AllocateInMemInstance();
    for (const std::uint32_t slot : cls.GetLayout().GetKeys()) {
        if (cls.GetLayout().GetDecl(slot).GetType().IsArray()) {
            Refuse(inventory, "its key " + cls.GetLayout().GetDecl(slot).GetName() + " is an array");
        }
        // Every key gets a value; Name and OSType get better ones below if they can.
        instance->SetSlot(slot, SomeValue(cls.GetLayout().GetDecl(slot).GetType(), cls.GetName()));
    }
    const std::uint32_t name = cls.GetLayout().FindSlot(kNameProperty);
    if (name != TInMemLayout::kNoSlot && cls.GetLayout().GetDecl(name).GetType() == TCIMValue::TCIMType::kString) {
        instance->SetSlot(name, system.name);
    }
    SetType(*instance, system.type);
    instance->AddToNamespace(TCallContext());
}

}  // namespace

std::vector<TSchemaNote> MakeMissingOperatingSystems(std::vector<TInventory>& inventories)
{
    std::vector<TSchemaNote> notes;
    for (std::size_t i = 0; i < inventories.size(); ++i) {
        boost::shared_ptr<TInMemClass> cls = inventories[i].ns->FindClass(kOperatingSystemClass);
        if (cls && cls->GetInstanceCount() > 0) {
            continue;
        }
        if (!cls) {
            cls = DeclareClass(inventories, inventories[i]);
        }
        try {
            AddInstance(inventories[i], *cls);
        } catch (const TZELException& error) {
            Refuse(inventories[i], error.what());
        }
        notes.push_back({TSchemaNote::kOperatingSystemMade, i, i, kOperatingSystemClass, std::string(), std::string()});
    }
    return notes;
}

}  // namespace NORVZEL20

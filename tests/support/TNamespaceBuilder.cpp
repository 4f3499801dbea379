#include "tests/support/TNamespaceBuilder.h"

#include "host/TZELException.h"

namespace NORVZEL20 {

using EType = TCIMValue::TCIMType::ECIMType;

TNamespaceBuilder::TProperty TNamespaceBuilder::Key(const std::string& name, EType type)
{
    return {name, type, true};
}

TNamespaceBuilder::TProperty TNamespaceBuilder::Property(const std::string& name, EType type)
{
    return {name, type, false};
}

TNamespaceBuilder::TNamespaceBuilder(boost::shared_ptr<ICIMNamespace> ns) : fNamespace(ns) {}

TNamespaceBuilder& TNamespaceBuilder::Class(const std::string& name, const std::string& superName,
                                            const std::vector<TProperty>& properties)
{
    const TCallContext none;
    boost::shared_ptr<ICIMClass> superClass;
    if (!superName.empty()) {
        superClass = fNamespace->GetClass(superName, none);
    }
    const auto cls = fNamespace->AllocateClass(name, superClass, none);
    for (const auto& property : properties) {
        const auto decl = cls->AllocatePropertyDecl(property.name, TCIMValue::Null(property.type), none);
        if (property.isKey) {
            decl->AddQualifier(decl->AllocateQualifier(KeyDecl(), TCIMValue(true), none), none);
        }
        cls->AddPropertyDecl(decl);
    }
    cls->AddToNamespace(none);
    return *this;
}

TNamespaceBuilder& TNamespaceBuilder::Instance(const std::string& className, const TValues& values)
{
    const TCallContext none;
    const auto instance = fNamespace->GetClass(className, none)->AllocateInstance(none);
    for (const auto& [name, value] : values) {
        instance->GetProperty(name, none)->SetValue(value, none);
    }
    instance->AddToNamespace(none);
    return *this;
}

TNamespaceBuilder& TNamespaceBuilder::OperatingSystem(unsigned short osType)
{
    Class("KALMO_OperatingSystem", "", {Key("Name"), Property("OSType", EType::kUint16)});
    return Instance("KALMO_OperatingSystem", {{"Name", "os"}, {"OSType", osType}});
}

TNamespaceBuilder& TNamespaceBuilder::DeltaSchema()
{
    Class("KALMO_DeltaClass", "", {Key("DeltaClassID", EType::kUint64), Property("ClassName")});
    Class("KALMO_Delta", "",
          {Key("DeltaID", EType::kUint64), Property("Type", EType::kUint8), Property("InstanceName"), Property("Property"),
           Property("NamespaceIndices", EType::kArrayUint16)});
    return Class("KALMO_DeltaClassAssocToDelta", "", {Key("Class", EType::kReference), Key("Delta", EType::kReference)});
}

boost::shared_ptr<ICIMQualifierDecl> TNamespaceBuilder::KeyDecl()
{
    const TCallContext none;
    try {
        return fNamespace->GetQualifierDecl("Key", none);
    } catch (const TZELException&) {
        const auto scope =
            static_cast<ICIMQualifierDecl::EScope>(ICIMQualifierDecl::kScopeProperty | ICIMQualifierDecl::kScopeReference);
        return fNamespace->AllocateQualifierDecl("Key", TCIMValue(false), scope, ICIMQualifierDecl::kFlavorToSubclass, none);
    }
}

}  // namespace NORVZEL20

#pragma once

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cstdint>
#include <initializer_list>
#include <string>
#include <vector>

#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TInMemQualifier.h"
#include "tests/support/NoContext.h"
#include "tests/support/StatusOf.h"

namespace NORVZEL20 {

/// A namespace "root/cimv2", verbs to fill it, and texts that describe what is in it.
class TInMemFixture : public testing::Test {
  protected:
    using TType = TCIMValue::TCIMType;
    using TClassPointer = boost::shared_ptr<TInMemClass>;
    using TInstancePointer = boost::shared_ptr<TInMemInstance>;

    /// A property to declare: name, type, and the names of qualifiers that are TRUE on it.
    struct TProperty {
        std::string name;
        TType::ECIMType type;
        std::vector<std::string> marks;
    };

    static boost::shared_ptr<ICIMQualifier> Qualifier(const std::string& name, const TCIMValue& value = TCIMValue(true),
                                                      ICIMQualifierDecl::EFlavor flavor = ICIMQualifierDecl::kFlavorDefault)
    {
        return boost::make_shared<TInMemQualifier>(name, value, flavor);
    }

    static boost::shared_ptr<TInMemPropertyDecl> Decl(const TProperty& property)
    {
        auto decl = boost::make_shared<TInMemPropertyDecl>(property.name, TCIMValue::Null(property.type));
        for (const std::string& mark : property.marks) {
            decl->AddQualifier(Qualifier(mark));
        }
        return decl;
    }

    static boost::shared_ptr<TInMemPropertyDecl> Reference(const std::string& name, const std::string& className)
    {
        auto decl = Decl({name, TType::kReference, {"Key"}});
        decl->SetReferenceClass(className);
        return decl;
    }

    TClassPointer Allocate(const std::string& name, const TClassPointer& superClass,
                           std::initializer_list<TProperty> properties = {})
    {
        auto cls = fNamespace->AllocateInMemClass(name, superClass);
        for (const TProperty& property : properties) {
            cls->AddPropertyDecl(Decl(property));
        }
        return cls;
    }

    TClassPointer Declare(const std::string& name, const TClassPointer& superClass,
                          std::initializer_list<TProperty> properties = {})
    {
        auto cls = Allocate(name, superClass, properties);
        cls->AddToNamespace(kNoContext);
        return cls;
    }

    /// Disk { Id string key; Size uint64; Label string; Tags string[] }
    TClassPointer DeclareDisk()
    {
        return Declare("Disk", nullptr,
                       {{"Id", TType::kString, {"Key"}},
                        {"Size", TType::kUint64, {}},
                        {"Label", TType::kString, {}},
                        {"Tags", TType::kArrayString, {}}});
    }

    static TInstancePointer Allocate(const TClassPointer& cls, std::initializer_list<std::pair<const char*, TCIMValue>> values)
    {
        auto instance = cls->AllocateInMemInstance();
        for (const auto& [name, value] : values) {
            instance->GetProperty(name, TCallContext())->SetValue(value, TCallContext());
        }
        return instance;
    }

    static TInstancePointer Add(const TClassPointer& cls, std::initializer_list<std::pair<const char*, TCIMValue>> values)
    {
        auto instance = Allocate(cls, values);
        instance->AddToNamespace(TCallContext());
        return instance;
    }

    static TCIMValue Uint64(std::uint64_t number) { return TCIMValue(number); }

    static TCIMValue Texts(std::initializer_list<const char*> texts)
    {
        std::vector<TCIMValue> elements;
        for (const char* const text : texts) {
            elements.emplace_back(text);
        }
        return TCIMValue(TType::kString, static_cast<unsigned>(elements.size()), elements);
    }

    TCIMReference Path(const std::string& text) const { return TCIMReference::Parse(text, fNamespace); }

    /// The names of the elements that `enumerate(callback)` delivers, with blanks between.
    template <class TElement, class TEnumerate>
    static std::string NamesOf(TEnumerate&& enumerate)
    {
        std::string names;
        enumerate([&names](boost::shared_ptr<TElement> element) {
            names += (names.empty() ? "" : " ") + element->GetName(TCallContext());
            return true;
        });
        return names;
    }

    static std::string SubClassesOf(ICIMClass& cls, bool deep)
    {
        return NamesOf<ICIMClass>([&](const auto& callback) { cls.EnumerateSubClasses(callback, deep, TCallContext()); });
    }

    static std::string PropertiesOf(const ICIMClass& cls)
    {
        return NamesOf<ICIMPropertyDecl>([&](const auto& callback) { cls.EnumeratePropertyDecls(callback, TCallContext()); });
    }

    static std::string QualifiersOf(const ICIMNamedElement& element)
    {
        return NamesOf<ICIMQualifier>([&](const auto& callback) { element.EnumerateQualifiers(callback, TCallContext()); });
    }

    static std::string KeysOf(const ICIMClass& cls)
    {
        std::string names;
        cls.EnumerateKeyNames(
            [&names](const std::string* name) {
                names += (names.empty() ? "" : " ") + *name;
                return true;
            },
            TCallContext());
        return names;
    }

    /// The paths of the instances, a line for each, without the namespace.
    static std::string InstancesOf(ICIMClass& cls, bool deep = false)
    {
        std::string paths;
        cls.EnumerateInstances(
            [&paths](boost::shared_ptr<ICIMInstance> instance) {
                TCIMReference path = instance->GetReference(TCallContext());
                path.SetNamespaceName("");
                paths += path.GetPath() + "\n";
                return true;
            },
            deep, TCallContext());
        return paths;
    }

    /// `Name=value` for each property, with blanks between.
    static std::string ValuesOf(const ICIMInstance& instance)
    {
        std::string values;
        instance.EnumerateProperties(
            [&values](boost::shared_ptr<ICIMProperty> property) {
                values += (values.empty() ? "" : " ") + property->GetPropertyDecl(TCallContext())->GetName(TCallContext()) + "=" +
                          property->GetValue(TCallContext()).ToText();
                return true;
            },
            TCallContext());
        return values;
    }

    boost::shared_ptr<TInMemNamespace> fNamespace = TInMemNamespace::Create("root/cimv2");
};

}  // namespace NORVZEL20

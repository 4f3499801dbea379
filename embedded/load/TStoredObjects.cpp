// Classes and properties, copied out of a namespace.
//
// A class of this host knows which properties, methods and qualifiers are its own and which it inherits. The interfaces of the host
// do not show that difference; they do not show parameters, array sizes and classes of references either. So the functions below
// check whether an object is one of this host (`inMemory` is not null). If so, they ask it directly; otherwise they copy what the
// interfaces show.
#include "embedded/load/TStoredObjects.h"

#include <optional>
#include <utility>

#include "embedded/load/OwnPartOf.h"
#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

namespace {

using TQualifiers = std::vector<TEmbeddedObject::TQualifier>;

TEmbeddedObject::TQualifier FromQualifier(const ICIMQualifier& qualifier)
{
    return {qualifier.GetName(TCallContext()), qualifier.GetValue(TCallContext()), qualifier.GetFlavor(TCallContext()), false};
}

/// The element's own qualifiers if it is one of this host (`inMemory` is not null), otherwise inherited ones too.
template <class TElement, class TInMemory>
TQualifiers FromQualifiers(const TElement& element, const TInMemory* inMemory)
{
    TQualifiers qualifiers;
    if (inMemory != nullptr) {
        for (const boost::shared_ptr<ICIMQualifier>& qualifier : inMemory->GetQualifiers().GetOwn()) {
            qualifiers.push_back(FromQualifier(*qualifier));
        }
        return qualifiers;
    }
    const auto add = [&](const boost::shared_ptr<ICIMQualifier>& qualifier) {
        qualifiers.push_back(FromQualifier(*qualifier));
        return true;
    };
    element.EnumerateQualifiers(add, TCallContext());
    return qualifiers;
}

TEmbeddedObject::TProperty FromPropertyDecl(const ICIMPropertyDecl& decl)
{
    TEmbeddedObject::TProperty property;
    property.name = decl.GetName(TCallContext());
    property.value = decl.GetDefaultValue(TCallContext());
    const auto* inMemory = dynamic_cast<const TInMemPropertyDecl*>(&decl);
    if (inMemory != nullptr) {
        property.referenceClass = inMemory->GetReferenceClass();
        property.arraySize = inMemory->GetArraySize();
    }
    property.qualifiers = FromQualifiers(decl, inMemory);
    return property;
}

}  // namespace

TEmbeddedObject::TMethod TStoredObjects::FromMethod(const ICIMMethodDecl& decl)
{
    TEmbeddedObject::TMethod method;
    method.name = decl.GetName(TCallContext());
    method.type = decl.GetType(TCallContext());
    const auto* inMemory = dynamic_cast<const TInMemMethodDecl*>(&decl);
    method.qualifiers = FromQualifiers(decl, inMemory);
    if (inMemory == nullptr) {
        return method;
    }
    // Only this host's declarations show their parameters.
    for (const boost::shared_ptr<TInMemParameter>& parameter : inMemory->GetParameters()) {
        method.parameters.push_back({parameter->GetName(), parameter->GetType(), parameter->GetReferenceClass(),
                                     parameter->GetArraySize(), FromQualifiers(*parameter, parameter.get())});
    }
    return method;
}

namespace {

/// Adds what a class of this host declares itself.
void AddOwnElements(TEmbeddedObject& object, const TInMemClass& cls)
{
    for (const boost::shared_ptr<TInMemPropertyDecl>& decl : cls.GetLayout().GetOwnDecls()) {
        object.AddProperty(FromPropertyDecl(*decl));
    }
    for (const boost::shared_ptr<TInMemMethodDecl>& decl : cls.GetMethods().GetOwn()) {
        object.AddMethod(TStoredObjects::FromMethod(*decl));
    }
}

/// Adds everything that a class of another host shows.
void AddAllElements(TEmbeddedObject& object, const ICIMClass& cls)
{
    const auto addProperty = [&](const boost::shared_ptr<ICIMPropertyDecl>& decl) {
        object.AddProperty(FromPropertyDecl(*decl));
        return true;
    };
    const auto addMethod = [&](const boost::shared_ptr<ICIMMethodDecl>& decl) {
        object.AddMethod(TStoredObjects::FromMethod(*decl));
        return true;
    };
    cls.EnumeratePropertyDecls(addProperty, TCallContext());
    cls.EnumerateMethodDecls(addMethod, TCallContext());
}

/// Takes out the qualifiers that repeat those of `above` (null for none).
template <class TElement>
void DropInheritedQualifiers(TElement& element, const TInMemQualifierSet* above)
{
    TQualifiers own;
    for (TEmbeddedObject::TQualifier& qualifier : element.qualifiers) {
        if (!IsInherited(qualifier, above)) {
            own.push_back(std::move(qualifier));
        }
    }
    element.qualifiers = std::move(own);
}

/// What the class itself declares of a property or a method, `above` being the inherited one (null for none).
template <class TElement, class TDecl>
std::optional<TElement> MakeOwn(const TElement& element, const boost::shared_ptr<TDecl>& above)
{
    if (above && element.propagated) {
        return OwnPartOf(element, *above);
    }
    TElement own = element;
    DropInheritedQualifiers(own, above ? &above->GetQualifiers() : nullptr);
    return own;
}

}  // namespace

TEmbeddedObject TStoredObjects::WithoutInherited(const TEmbeddedObject& cls, const TInMemClass* super)
{
    TEmbeddedObject object(cls.GetClassName(), true);
    object.SetSuperClassName(cls.GetSuperClassName());
    for (const TEmbeddedObject::TQualifier& qualifier : cls.GetQualifiers()) {
        if (!IsInherited(qualifier, super != nullptr ? &super->GetQualifiers() : nullptr)) {
            object.AddQualifier(qualifier);
        }
    }
    for (const TEmbeddedObject::TProperty& property : cls.GetProperties()) {
        const auto above = super != nullptr ? super->FindPropertyDecl(property.name) : nullptr;
        if (std::optional<TEmbeddedObject::TProperty> own = MakeOwn(property, above)) {
            object.AddProperty(std::move(*own));
        }
    }
    for (const TEmbeddedObject::TMethod& method : cls.GetMethods()) {
        const auto above = super != nullptr ? super->GetMethods().Find(method.name) : nullptr;
        if (std::optional<TEmbeddedObject::TMethod> own = MakeOwn(method, above)) {
            object.AddMethod(std::move(*own));
        }
    }
    return object;
}

TEmbeddedObject TStoredObjects::FromClass(const ICIMClass& cls)
{
    TEmbeddedObject object(cls.GetName(TCallContext()), true);
    if (const boost::shared_ptr<ICIMClass> super = cls.GetSuperClass(TCallContext())) {
        object.SetSuperClassName(super->GetName(TCallContext()));
    }
    const auto* inMemory = dynamic_cast<const TInMemClass*>(&cls);
    for (TEmbeddedObject::TQualifier& qualifier : FromQualifiers(cls, inMemory)) {
        object.AddQualifier(std::move(qualifier));
    }
    if (inMemory != nullptr) {
        AddOwnElements(object, *inMemory);
    } else {
        AddAllElements(object, cls);
    }
    return object;
}

TEmbeddedObject::TProperty TStoredObjects::FromProperty(const ICIMProperty& property)
{
    const boost::shared_ptr<const ICIMPropertyDecl> decl = property.GetPropertyDecl(TCallContext());
    TEmbeddedObject::TProperty result;
    result.name = decl->GetName(TCallContext());
    result.value = property.GetValue(TCallContext());
    if (const auto* inMemory = dynamic_cast<const TInMemPropertyDecl*>(decl.get())) {
        result.referenceClass = inMemory->GetReferenceClass();
        result.arraySize = inMemory->GetArraySize();
    }
    if (result.value.IsNull()) {  // null values are written with the declared type
        result.value = TCIMValue::Null(decl->GetType(TCallContext()));
    }
    return result;
}

}  // namespace NORVZEL20

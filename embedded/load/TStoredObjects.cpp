// Classes and properties, copied out of a namespace.
//
// A class of this host knows which properties, methods and qualifiers are its own and which it inherits. The interfaces of the host
// do not show that difference; they do not show parameters, array sizes and classes of references either. So the functions below
// check whether an object is one of this host (`inMemory` is not null). If so, they ask it directly; otherwise they copy what the
// interfaces show.
#include "embedded/load/TStoredObjects.h"

#include <type_traits>
#include <utility>

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

TEmbeddedObject::TMethod FromMethodDecl(const ICIMMethodDecl& decl)
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

/// Adds what a class of this host declares itself.
void AddOwnElements(TEmbeddedObject& object, const TInMemClass& cls)
{
    for (const boost::shared_ptr<TInMemPropertyDecl>& decl : cls.GetLayout().GetOwnDecls()) {
        object.AddProperty(FromPropertyDecl(*decl));
    }
    for (const boost::shared_ptr<TInMemMethodDecl>& decl : cls.GetMethods().GetOwn()) {
        object.AddMethod(FromMethodDecl(*decl));
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
        object.AddMethod(FromMethodDecl(*decl));
        return true;
    };
    cls.EnumeratePropertyDecls(addProperty, TCallContext());
    cls.EnumerateMethodDecls(addMethod, TCallContext());
}

/// The elements without the propagated ones, and without propagated qualifiers on the others.
template <class TElement>
std::vector<TElement> OwnOf(const std::vector<TElement>& elements)
{
    std::vector<TElement> own;
    for (const TElement& element : elements) {
        if (!element.propagated) {
            own.push_back(element);
        }
    }
    // Properties and methods have qualifiers of their own, which may be propagated; qualifiers have none.
    if constexpr (!std::is_same_v<TElement, TEmbeddedObject::TQualifier>) {
        for (TElement& element : own) {
            element.qualifiers = OwnOf(element.qualifiers);
        }
    }
    return own;
}

}  // namespace

TEmbeddedObject TStoredObjects::WithoutInherited(const TEmbeddedObject& cls)
{
    TEmbeddedObject object(cls.GetClassName(), true);
    object.SetSuperClassName(cls.GetSuperClassName());
    for (TEmbeddedObject::TQualifier& qualifier : OwnOf(cls.GetQualifiers())) {
        object.AddQualifier(std::move(qualifier));
    }
    for (TEmbeddedObject::TProperty& property : OwnOf(cls.GetProperties())) {
        object.AddProperty(std::move(property));
    }
    for (TEmbeddedObject::TMethod& method : OwnOf(cls.GetMethods())) {
        object.AddMethod(std::move(method));
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

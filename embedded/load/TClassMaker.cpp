// From the draft of a class to the class.
//
// Two kinds of documents exist. Some list only what a class itself declares; others repeat what it inherits, marked PROPAGATED.
// Both must give the same class, so a part that is marked and that says what the superclass says is left out; OwnPartOf decides. A
// part that is marked but that no superclass declares would otherwise be lost, and so is taken as the class's own.
//
// Names are checked here, because here they become part of paths. Limits are checked with inherited parts included, which a draft
// cannot know: every instance of every subclass has room for each property.
#include "embedded/load/TClassMaker.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <optional>

#include "embedded/load/MessageText.h"
#include "embedded/load/OwnPartOf.h"
#include "embedded/store/TInMemQualifier.h"
#include "embedded/store/TSchemaLimits.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

boost::shared_ptr<TInMemClass> TClassMaker::Make(const TDraft& draft, const boost::shared_ptr<TInMemClass>& super)
{
    const TEmbeddedObject& object = draft.object;
    if (super && super->CountSuperClasses() >= TSchemaLimits::kMaxSuperClasses) {
        fContext.Fail(EStatus::kParseError, "found class " + Quote(object.GetClassName()) + " below more than " +
                                                std::to_string(TSchemaLimits::kMaxSuperClasses) +
                                                " superclasses; flatten the class tree");
    }
    fContext.CheckName("class", object.GetClassName());
    const boost::shared_ptr<TInMemClass> cls = fNamespace.AllocateInMemClass(object.GetClassName(), super);
    AddQualifiers(*cls, object.GetQualifiers(), super ? &super->GetQualifiers() : nullptr);
    for (std::size_t index = 0; index < object.GetProperties().size(); ++index) {
        const TLoadContext::TAt at(fContext, draft.propertyPlaces[index]);
        AddProperty(*cls, object.GetProperties()[index], super.get());
        if (cls->GetLayout().GetOrder().size() > TSchemaLimits::kMaxProperties) {
            FailTooMany(TSchemaLimits::kMaxProperties, "properties", object.GetClassName());
        }
    }
    // Overridden methods count again, as TSchemaLimits says.
    std::size_t methods = 0;
    for (const TInMemClass* above = super.get(); above != nullptr; above = above->GetSuperInMemClass().get()) {
        methods += above->GetMethods().GetOwn().size();
    }
    for (const TEmbeddedObject::TMethod& method : object.GetMethods()) {
        AddMethod(*cls, method, super.get());
        if (methods + cls->GetMethods().GetOwn().size() > TSchemaLimits::kMaxMethods) {
            FailTooMany(TSchemaLimits::kMaxMethods, "methods", object.GetClassName());
        }
    }
    return cls;
}

void TClassMaker::FailTooMany(std::size_t most, const char* what, const std::string& className) const
{
    fContext.Fail(EStatus::kParseError, "found more than " + std::to_string(most) + " " + what + " in class " + Quote(className) +
                                            ", inherited ones included; split it");
}

void TClassMaker::FailSecond(const char* what, const std::string& name, const TInMemClass& cls) const
{
    fContext.Fail(EStatus::kParseError,
                  std::string("found a second declaration of ") + what + " " + Quote(name) + " in class " + Quote(cls.GetName()));
}

void TClassMaker::AddProperty(TInMemClass& cls, const TEmbeddedObject::TProperty& property, const TInMemClass* super)
{
    fContext.CheckName("property", property.name);
    const TCIMValue::TCIMType type = property.value.GetType();
    const boost::shared_ptr<TInMemPropertyDecl> inherited =
        super != nullptr ? super->FindPropertyDecl(property.name) : boost::shared_ptr<TInMemPropertyDecl>();
    if (inherited && inherited->GetType() != type) {
        fContext.Fail(EStatus::kTypeMismatch, "found property " + Quote(property.name) + " of type " +
                                                  TValueText::DescribeType(type) + " in class " + Quote(cls.GetName()) +
                                                  ", but a superclass declares it as " +
                                                  TValueText::DescribeType(inherited->GetType()));
    }
    // The type was compared above.
    if (!inherited || !property.propagated) {
        return DeclareProperty(cls, property, inherited.get());
    }
    if (const std::optional<TEmbeddedObject::TProperty> own = OwnPartOf(property, *inherited)) {
        DeclareProperty(cls, *own, inherited.get());
    }
}

void TClassMaker::DeclareProperty(TInMemClass& cls, const TEmbeddedObject::TProperty& property, const TInMemPropertyDecl* inherited)
{
    const auto decl = boost::make_shared<TInMemPropertyDecl>(property.name, property.value);
    decl->SetReferenceClass(property.referenceClass);
    decl->SetArraySize(property.arraySize);
    AddQualifiers(*decl, property.qualifiers, inherited ? &inherited->GetQualifiers() : nullptr);
    if (!cls.AddPropertyDecl(decl)) {
        FailSecond("property", property.name, cls);
    }
}

void TClassMaker::AddMethod(TInMemClass& cls, const TEmbeddedObject::TMethod& method, const TInMemClass* super)
{
    const boost::shared_ptr<TInMemMethodDecl> inherited =
        super != nullptr ? super->GetMethods().Find(method.name) : boost::shared_ptr<TInMemMethodDecl>();
    if (!inherited || !method.propagated) {
        return DeclareMethod(cls, method, inherited.get());
    }
    if (const std::optional<TEmbeddedObject::TMethod> own = OwnPartOf(method, *inherited)) {
        DeclareMethod(cls, *own, inherited.get());
    }
}

void TClassMaker::DeclareMethod(TInMemClass& cls, const TEmbeddedObject::TMethod& method, const TInMemMethodDecl* inherited)
{
    const auto decl = boost::make_shared<TInMemMethodDecl>(method.name, method.type);
    for (const TEmbeddedObject::TParameter& parameter : method.parameters) {
        const auto made = boost::make_shared<TInMemParameter>(parameter.name, parameter.type);
        made->SetReferenceClass(parameter.referenceClass);
        made->SetArraySize(parameter.arraySize);
        AddQualifiers(*made, parameter.qualifiers, nullptr);
        decl->AddParameter(made);
    }
    AddQualifiers(*decl, method.qualifiers, inherited ? &inherited->GetQualifiers() : nullptr);
    if (!cls.AddMethodDecl(decl)) {
        FailSecond("method", method.name, cls);
    }
}

template <class TElement>
void TClassMaker::AddQualifiers(TElement& element, const TQualifiers& qualifiers, const TInMemQualifierSet* inherited)
{
    if (qualifiers.size() + (inherited != nullptr ? inherited->CountAll() : 0) > TSchemaLimits::kMaxQualifiers) {
        fContext.Fail(EStatus::kParseError, "found more than " + std::to_string(TSchemaLimits::kMaxQualifiers) +
                                                " qualifiers on one element, inherited ones included; remove some");
    }
    for (const TEmbeddedObject::TQualifier& qualifier : qualifiers) {
        if (IsInherited(qualifier, inherited)) {
            continue;
        }
        if (!fIsKnown) {
            NoteQualifier(qualifier, inherited != nullptr ? inherited->Find(qualifier.name).get() : nullptr);
        }
        element.AddQualifier(boost::make_shared<TInMemQualifier>(qualifier.name, qualifier.value, qualifier.flavor));
    }
}

/// Notes what is odd about a qualifier. Servers' answers come without any declarations of qualifiers, published schemas restate
/// flavors.
void TClassMaker::NoteQualifier(const TEmbeddedObject::TQualifier& qualifier, const ICIMQualifier* inherited)
{
    const bool areDeclared = !fNamespace.GetQualifierDecls().empty();
    if (areDeclared && !fNamespace.FindQualifierDecl(qualifier.name)) {
        fContext.Tolerate("undeclared qualifier",
                          "qualifier " + Quote(qualifier.name) + " is not declared; taken as it is written");
    }
    if (inherited != nullptr && inherited->GetFlavor(TCallContext()) != qualifier.flavor) {
        fContext.Tolerate("other flavor",
                          "qualifier " + Quote(qualifier.name) +
                              " is restated with another flavor than the superclass gives it; taken as it is written");
    }
}

}  // namespace NORVZEL20

// Copying declarations from one namespace to another.
//
// A class needs its superclasses, and its qualifiers should be declared. So a class is copied from the top down: first the
// superclasses that the target lacks, each with its own properties, methods and qualifiers only, because it inherits the rest
// in the target. The superclasses that the target has may differ from the original's; a conflict of types shows when the copy is
// declared, and the staging then takes back every class of the call. Every class and every property is held against the limits
// before it is declared: two schemas within the limits can go beyond them together.

#include "embedded/store/TSchemaCopier.h"

#include "embedded/store/TDeclCopy.h"
#include "embedded/store/TInMemStaging.h"
#include "embedded/store/TSchemaLimitError.h"
#include "embedded/store/TSchemaLimits.h"

namespace NORVZEL20 {

namespace {

void CheckHeight(const TInMemClass& cls)
{
    if (cls.CountSuperClasses() > TSchemaLimits::kMaxSuperClasses) {
        throw TSchemaLimitError("it would have more than " + std::to_string(TSchemaLimits::kMaxSuperClasses) +
                                " superclasses; flatten the class tree");
    }
}

void CheckWidth(const TInMemClass& cls, std::size_t properties)
{
    if (properties > TSchemaLimits::kMaxProperties) {
        throw TSchemaLimitError("class " + cls.GetName() + " would have more than " +
                                std::to_string(TSchemaLimits::kMaxProperties) + " properties; split it");
    }
}

}  // namespace

std::vector<boost::shared_ptr<TInMemClass>> TSchemaCopier::CopyClass(const TInMemClass& source)
{
    std::vector<const TInMemClass*> missing;
    for (const TInMemClass* cls = &source; cls && !fTarget->FindClass(cls->GetName()); cls = cls->GetSuperInMemClass().get()) {
        missing.push_back(cls);
    }
    std::vector<boost::shared_ptr<TInMemClass>> declared;
    TInMemStaging staging(fTarget);
    // Superclasses first. If one fails, the staging is destroyed without Commit and takes all of them back.
    for (auto cls = missing.rbegin(); cls != missing.rend(); ++cls) {
        declared.push_back(MakeClass(**cls));
        staging.AddClass(declared.back());
    }
    staging.Commit();
    return declared;
}

boost::shared_ptr<TInMemClass> TSchemaCopier::MakeClass(const TInMemClass& source)
{
    const auto& superClass = source.GetSuperInMemClass();
    const auto from = source.GetInMemNamespace();
    auto copy = fTarget->AllocateInMemClass(source.GetName(), superClass ? fTarget->FindClass(superClass->GetName()) : nullptr);
    CheckHeight(*copy);
    CopyQualifierDecls(source.GetQualifiers(), from.get());
    TDeclCopy::CopyOwnQualifiers(source.GetQualifiers(), *copy);
    for (const auto& decl : source.GetLayout().GetOwnDecls()) {
        CopyQualifierDecls(decl->GetQualifiers(), from.get());
        copy->AddPropertyDecl(TDeclCopy::CopyProperty(*decl));
        CheckWidth(*copy, copy->GetLayout().GetOrder().size());
    }
    for (const auto& method : source.GetMethods().GetOwn()) {
        CopyQualifierDecls(method->GetQualifiers(), from.get());
        copy->AddMethodDecl(TDeclCopy::CopyMethod(*method));
    }
    return copy;
}

boost::shared_ptr<TInMemPropertyDecl> TSchemaCopier::CopyPropertyDecl(const TInMemPropertyDecl& source, TInMemClass& cls)
{
    if (cls.FindPropertyDecl(source.GetName())) {
        return nullptr;
    }
    // Every class below gets the property too, so all are checked before anything is declared.
    CheckWidth(cls, cls.GetLayout().GetOrder().size() + 1);
    for (const auto& below : cls.GetClassesBelow()) {
        CheckWidth(*below, below->GetLayout().GetOrder().size() + (below->FindPropertyDecl(source.GetName()) ? 0 : 1));
    }
    const auto owner = source.GetOwner();
    const auto from = owner ? owner->GetInMemNamespace() : nullptr;
    CopyQualifierDecls(source.GetQualifiers(), from.get());
    auto copy = TDeclCopy::CopyProperty(source);
    // The default of a static property is its value, and the target has none.
    copy->GetStaticProperty().SetValue(TCIMValue());
    cls.AddPropertyDecl(copy);
    return copy;
}

void TSchemaCopier::CopyQualifierDecls(const TInMemQualifierSet& element, const TInMemNamespace* from)
{
    if (!from) {
        return;
    }
    element.Enumerate([this, from](boost::shared_ptr<ICIMQualifier> qualifier) {
        const std::string& name = qualifier->GetName(TCallContext());
        const auto decl = from->FindQualifierDecl(name);
        if (decl && !fTarget->FindQualifierDecl(name)) {
            fTarget->AddQualifierDecl(decl);  // immutable, and so it may be shared
        }
        return true;
    });
}

bool TSchemaCopier::RespellClass(const std::string& name)
{
    const auto cls = fTarget->FindClass(name);
    if (!cls || cls->GetName() == name) {
        return false;
    }
    cls->SetSpelling(name);
    return true;
}

bool TSchemaCopier::RespellProperty(TInMemClass& cls, const std::string& name)
{
    const auto decl = cls.FindPropertyDecl(name);
    if (!decl || decl->GetName() == name) {
        return false;
    }
    if (decl->GetOwner().get() == &cls) {
        decl->SetSpelling(name);
        return true;
    }
    // An inherited property is overridden by a copy, because the superclass keeps its spelling.
    const auto own = TDeclCopy::CopyProperty(*decl);
    own->SetSpelling(name);
    if (own->IsStatic()) {
        own->GetStaticProperty().SetValue(decl->GetStaticProperty().GetValue());
    }
    cls.AddPropertyDecl(own);
    return true;
}

}  // namespace NORVZEL20

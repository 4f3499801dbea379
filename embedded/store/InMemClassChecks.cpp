#include "embedded/store/InMemClassChecks.h"

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TStoreRefusal.h"

namespace NORVZEL20 {

namespace {

void RequireSame(const TInMemClass& cls, const char* kind, const std::string& name, TCIMValue::TCIMType present,
                 TCIMValue::TCIMType other)
{
    if (present != other) {
        throw TStoreRefusal(TZELStatusCode::kTypeMismatch, [&] {
            return kind + name + " of class " + cls.GetName() + TStoreRefusal::OfOtherType(present, other);
        });
    }
}

/// The class has inherited properties too, so this covers all ancestors.
void CheckTypeFitsHere(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    if (const auto present = cls.FindPropertyDecl(decl.GetName())) {
        RequireSame(cls, "property ", present->GetName(), present->GetType(), decl.GetType());
    }
}

/// Without instances a class may lose a key. Otherwise another declaration of the property must still make it one.
void CheckKeyStaysHere(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    const auto present = cls.FindPropertyDecl(decl.GetName());
    if (cls.GetInstanceCount() > 0 && present && present->IsKey() && !present->IsKeyWithout(decl)) {
        throw TStoreRefusal(TZELStatusCode::kClassInUse,
                            [&] { return "key " + present->GetName() + " of class " + cls.GetName() + ", which has instances"; });
    }
}

}  // namespace

void CheckTypeFits(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    CheckTypeFitsHere(cls, decl);
    for (const auto& below : cls.GetClassesBelow()) {
        CheckTypeFitsHere(*below, decl);
    }
}

void CheckKeyStays(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    CheckKeyStaysHere(cls, decl);
    for (const auto& below : cls.GetClassesBelow()) {
        CheckKeyStaysHere(*below, decl);
    }
}

void CheckTypesAgree(const ICIMClass& source, const TInMemClass& target)
{
    const TCallContext none;
    source.EnumeratePropertyDecls(
        [&](boost::shared_ptr<ICIMPropertyDecl> decl) {
            if (const auto same = target.FindPropertyDecl(decl->GetName(none))) {
                RequireSame(target, "property ", same->GetName(), same->GetType(), decl->GetType(none));
            }
            return true;
        },
        none);
    source.EnumerateMethodDecls(
        [&](boost::shared_ptr<ICIMMethodDecl> decl) {
            if (const auto same = target.GetMethods().Find(decl->GetName(none))) {
                RequireSame(target, "method ", same->GetName(), same->GetType(), decl->GetType(none));
            }
            return true;
        },
        none);
}

}  // namespace NORVZEL20

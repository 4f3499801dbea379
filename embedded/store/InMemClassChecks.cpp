#include "embedded/store/InMemClassChecks.h"

#include "embedded/store/TInMemClass.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

/// The layout has inherited properties too, so this covers all ancestors.
void CheckTypeFitsHere(const TInMemLayout& layout, const TInMemPropertyDecl& decl)
{
    const std::uint32_t slot = layout.FindSlot(decl.GetName());
    if (slot != TInMemLayout::kNoSlot && layout.GetDecl(slot).GetType() != decl.GetType()) {
        throw TZELException(TZELStatusCode::kTypeMismatch);
    }
}

/// Without instances a class may lose a key. Otherwise another declaration of the property must still make it one.
void CheckKeyStaysHere(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    const auto present = cls.FindPropertyDecl(decl.GetName());
    if (cls.GetInstanceCount() > 0 && present && present->IsKey() && !present->IsKeyWithout(decl)) {
        throw TZELException(TZELStatusCode::kClassInUse);
    }
}

void RequireSame(TCIMValue::TCIMType a, TCIMValue::TCIMType b)
{
    if (a != b) {
        throw TZELException(TZELStatusCode::kTypeMismatch);
    }
}

}  // namespace

void CheckTypeFits(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    CheckTypeFitsHere(cls.GetLayout(), decl);
    for (const auto& below : cls.GetClassesBelow()) {
        CheckTypeFitsHere(below->GetLayout(), decl);
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
                RequireSame(same->GetType(), decl->GetType(none));
            }
            return true;
        },
        none);
    source.EnumerateMethodDecls(
        [&](boost::shared_ptr<ICIMMethodDecl> decl) {
            if (const auto same = target.GetMethods().Find(decl->GetName(none))) {
                RequireSame(same->GetType(), decl->GetType(none));
            }
            return true;
        },
        none);
}

}  // namespace NORVZEL20

#include "embedded/store/InMemClassChecks.h"

#include "embedded/store/TInMemClass.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

void CheckTypeFitsHere(const TInMemLayout& layout, const TInMemPropertyDecl& decl)
{
    const std::uint32_t slot = layout.FindSlot(decl.GetName());
    if (slot != TInMemLayout::kNoSlot && layout.GetDecl(slot).GetType() != decl.GetType()) {
        throw TZELException(TZELStatusCode::kTypeMismatch);
    }
}

void CheckKeyStaysHere(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    const auto present = cls.FindPropertyDecl(decl.GetName());
    if (cls.GetInstanceCount() > 0 && present && present->IsKey() && !present->IsKeyWithout(decl)) {
        throw TZELException(TZELStatusCode::kClassInUse);
    }
}

}  // namespace

void CheckTypeFits(const TInMemClass& cls, const TInMemPropertyDecl& decl)
{
    CheckTypeFitsHere(cls.GetLayout(), decl);  // has what ancestors declare, too
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

}  // namespace NORVZEL20

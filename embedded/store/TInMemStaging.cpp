// Loading all or nothing.
//
// Things are added to the namespace itself, not to a copy, because later ones must find earlier ones: a class its superclass, a
// reference its class. To undo this, the staging notes what it added. For classes and qualifier declarations that is a list. For
// instances it is one mark for each extent, taken before the first instance goes in: everything behind the mark is new, because
// nothing is removed meanwhile. Undoing goes backwards: static values, instances, classes with subclasses first, qualifier
// declarations. None of these steps needs memory, so undoing cannot fail.

#include "embedded/store/TInMemStaging.h"

namespace NORVZEL20 {

TInMemStaging::TInMemStaging(boost::shared_ptr<TInMemNamespace> ns) noexcept : fNamespace(std::move(ns)) {}

TInMemStaging::~TInMemStaging()
{
    if (fCommitted) {
        return;
    }
    for (const auto& [key, kept] : fStaticValues) {
        kept.decl->GetStaticProperty().SetState(kept.state);
    }
    for (const auto& [extent, mark] : fExtents) {
        extent->RollBack(mark);
    }
    for (auto cls = fClasses.rbegin(); cls != fClasses.rend(); ++cls) {
        fNamespace->Withdraw(**cls);
    }
    for (auto decl = fQualifierDecls.rbegin(); decl != fQualifierDecls.rend(); ++decl) {
        fNamespace->Withdraw(**decl);
    }
}

void TInMemStaging::AddQualifierDecl(const boost::shared_ptr<TInMemQualifierDecl>& decl)
{
    fQualifierDecls.push_back(decl);
    try {
        fNamespace->AddQualifierDecl(decl);
    } catch (...) {
        fQualifierDecls.pop_back();
        throw;
    }
}

void TInMemStaging::AddClass(const boost::shared_ptr<TInMemClass>& cls)
{
    fClasses.push_back(cls);
    try {
        fNamespace->Declare(cls);
    } catch (...) {
        fClasses.pop_back();
        throw;
    }
}

TInMemExtent& TInMemStaging::GetMarkedExtent(TInMemClass& cls)
{
    TInMemExtent& extent = cls.GetExtent();
    if (&extent != fLast) {
        fExtents.emplace(&extent, extent.GetMark());
        fLast = &extent;
    }
    return extent;
}

void TInMemStaging::AddInstance(const boost::shared_ptr<TInMemInstance>& instance)
{
    GetMarkedExtent(*instance->GetInMemClass()).Add(instance);
}

void TInMemStaging::KeepStaticValues(const TInMemClass& cls)
{
    const TInMemLayout& layout = cls.GetLayout();
    for (const std::uint32_t slot : layout.GetOrder()) {
        const boost::shared_ptr<TInMemPropertyDecl>& decl = layout.GetSharedDecl(slot);
        if (decl->IsStatic()) {
            fStaticValues.emplace(decl.get(), TStaticValue{decl, decl->GetStaticProperty().GetState()});
        }
    }
}

void TInMemStaging::Commit() noexcept
{
    fCommitted = true;
}

}  // namespace NORVZEL20

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

TInMemExtent& TInMemStaging::Touch(TInMemClass& cls)
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
    Touch(*instance->GetInMemClass()).Add(instance);
}

void TInMemStaging::KeepStaticValues(const TInMemClass& cls)
{
    for (const std::uint32_t slot : cls.GetSlotOrder()) {
        const boost::shared_ptr<TInMemPropertyDecl>& decl = cls.GetSharedSlotDecl(slot);
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

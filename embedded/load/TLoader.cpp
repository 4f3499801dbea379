// All of a document, or nothing.
//
// What is read is added to the namespace at once, through a staging that remembers it. If anything fails, the exception passes
// through here, the staging is destroyed without Commit, and takes everything out again. What cannot be added yet waits:
//
// 1. Classes wait in TClassQueue until an instance needs them or the document ends.
// 2. Instances of a declared class are filled by TInstanceBuilder while they are read, and added at their end.
// 3. Instances that need a class which has not come yet are kept in TLateInstances.
// 4. When the document has ended, Finish declares the remaining classes and fills the instances that waited as drafts. Then all
//    references have been seen, so it is decided which are local; the noted ones are written again, and the held instances, to
//    which those of the drafts belong by now, are added. What is still missing then is an error.
#include "embedded/load/TLoader.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/load/TClassInference.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

TLoader::TLoader(TLoadContext& context, const boost::shared_ptr<TInMemNamespace>& ns)
    : fContext(context), fNamespace(ns), fStaging(ns), fClasses(context, *ns, fStaging), fRepeats(context),
      fBuilder(context, *ns, fStaging, fClasses, fLate, fRepeats)
{
    if (fContext.GetOptions().takesDeclarationsOnly) {
        fLate.StartWaiting();  // so that all instances come to AddInstance
    }
}

TLoader::~TLoader() = default;

void TLoader::AddQualifierDecl(const TQualifierDraft& draft)
{
    fContext.GetContents().NoteObject();
    const boost::shared_ptr<TInMemQualifierDecl> known = fNamespace->FindQualifierDecl(draft.name);
    if (!known) {
        fStaging.AddQualifierDecl(boost::make_shared<TInMemQualifierDecl>(draft.name, draft.value, draft.scope, draft.flavor));
        ++fContext.GetReport().qualifierDecls;
        return;
    }
    if (known->GetValue().GetType() != draft.value.GetType() || known->GetValue() != draft.value) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second declaration of qualifier " + Quote(draft.name) +
                                                   " that differs from the first in type or value; remove one");
    }
    fContext.Tolerate("repeated qualifier", "qualifier " + Quote(draft.name) + " is declared again; the first declaration stands");
}

void TLoader::AddClass(TDraft draft)
{
    fContext.GetContents().NoteObject();
    fContext.GetBadValues().LeaveNameless();
    fClasses.Add(std::move(draft));
}

bool TLoader::BeginInstance(const char* className)
{
    fContext.GetContents().NoteObject();
    if (!fLate.IsWaiting() && fBuilder.Begin(className)) {
        return true;
    }
    fLate.StartWaiting();
    return false;
}

void TLoader::EndInstance(const TOwnKeys* ownKeys)
{
    const boost::shared_ptr<TInMemInstance> instance = fBuilder.Take(ownKeys);
    if (fContext.GetBadValues().LackInstance()) {
        fContext.GetBadValues().NameInstance(instance->GetReference());
    }
    if (fBuilder.IsHeld() || fHasEnded) {
        fLate.Hold(instance, fContext.GetPlace());
    } else {
        Add(instance);
    }
    ++fContext.GetReport().instances;
    if (fKeep) {
        fKeptInstances.push_back(instance);
    }
}

void TLoader::Add(const boost::shared_ptr<TInMemInstance>& instance)
{
    try {
        fStaging.AddInstance(instance);
    } catch (const TZELException& error) {
        if (error.GetStatusCode().GetStatus() != EStatus::kAlreadyExists) {
            Explain(error, *instance);
        }
        return fRepeats.NoteRepeated(instance);
    }
    fRepeats.NoteAdded(*instance->GetInMemClass(), fContext.GetPlace());
}

/// The namespace says what it refuses; the message of a load also says what to do.
void TLoader::Explain(const TZELException& error, const TInMemInstance& instance) const
{
    const EStatus status = error.GetStatusCode().GetStatus();
    const std::string ofClass = " of class " + Quote(instance.GetInMemClass()->GetName());
    if (status == EStatus::kKeyMissing) {
        fContext.Fail(status, "found an instance" + ofClass + " without a value for its key " + Quote(*instance.FindMissingKey()) +
                                  "; every key needs one");
    }
    fContext.Fail(status, "found an instance" + ofClass + " that cannot be added: " + error.what());
}

void TLoader::Fill(const TDraft& draft, const TReadObjects& readObjects)
{
    const TLoadContext::TAt at(fContext, draft.place);
    fBuilder.Fill(draft, readObjects);
    EndInstance(&draft.ownKeys);
}

void TLoader::FillInstance(TDraft draft, const TReadObjects& readObjects)
{
    fContext.GetContents().NoteObject();
    if (fLate.IsWaiting()) {
        AddInstance(std::move(draft));
    } else {
        Fill(draft, readObjects);
    }
}

/// Bad values are noted when it is filled; only those within embedded objects and paths have been noted by now.
void TLoader::AddInstance(TDraft draft)
{
    fContext.GetContents().NoteObject();
    fContext.GetBadValues().LeaveNameless();
    if (!fContext.GetOptions().takesDeclarationsOnly) {
        fLate.Wait(std::move(draft));
    }
}

/// Declares a qualifier that the documents need not declare themselves.
void TLoader::DeclareQualifier(const TQualifierDraft& draft)
{
    if (!fNamespace->FindQualifierDecl(draft.name)) {
        fStaging.AddQualifierDecl(boost::make_shared<TInMemQualifierDecl>(draft.name, draft.value, draft.scope, draft.flavor));
    }
}

/// Instances of classes that nothing declares wait as drafts, with all that come after the first of them.
void TLoader::InferClasses()
{
    TClassInference inference(fContext);
    for (const TDraft& draft : fLate.GetDrafts()) {
        if (!fClasses.Find(draft.object.GetClassName().c_str())) {
            inference.Note(draft);
        }
    }
    std::vector<TDraft> classes = inference.MakeClasses();
    if (!classes.empty()) {
        for (const TQualifierDraft& qualifier : TClassInference::DescribeQualifiers()) {
            DeclareQualifier(qualifier);
        }
    }
    for (TDraft& cls : classes) {
        fClasses.Add(std::move(cls));
    }
    fClasses.DeclareAll();
}

void TLoader::Finish(const TReadObjects& readObjects)
{
    fHasEnded = true;
    fClasses.DeclareAll();
    if (fContext.GetOptions().schema) {
        fLate.ForEachClass([this](const std::string& name) { fClasses.Find(name.c_str()); });
    }
    if (fContext.GetOptions().infersClasses) {
        InferClasses();
    }
    fLate.AdaptReferences(fContext.GetOwnPlace(), *fNamespace, fClasses.CountDeclared());
    for (const TDraft& draft : fLate.TakeDrafts()) {
        Fill(draft, readObjects);
    }
    TOwnPlaceSearch& place = fContext.GetOwnPlace();
    place.Decide(place.IsMixed() && fLate.LeadTo(*fNamespace));
    fOwnPlace = place.GetNamed();
    fClasses.MakeDefaultsLocal();
    fLate.MakeReferencesLocal(place);
    for (const TLateInstances::THeld& held : fLate.TakeHeld()) {
        const TLoadContext::TAt at(fContext, held.place);
        Add(held.instance);
    }
    DropRepeated();
}

/// Instances that came twice count once.
void TLoader::DropRepeated()
{
    fRepeats.Check();
    fContext.GetReport().instances -= fRepeats.GetCount();
    if (fRepeats.GetCount() > 0 && fKeep) {
        const std::unordered_set<const TInMemInstance*> repeated = fRepeats.GetRepeated();
        const auto isRepeated = [&repeated](const boost::shared_ptr<ICIMElement>& kept) {
            return repeated.count(static_cast<const TInMemInstance*>(kept.get())) > 0;
        };
        fKeptInstances.erase(std::remove_if(fKeptInstances.begin(), fKeptInstances.end(), isRepeated), fKeptInstances.end());
    }
}

/// References that turn up later, when text becomes one, are to be local too, so the namespace needs what the load has found out.
void TLoader::Commit() noexcept
{
    fNamespace->SetOwnPlace(std::move(fOwnPlace));
    fStaging.Commit();
}

std::vector<boost::shared_ptr<ICIMElement>> TLoader::TakeElements()
{
    if (!fKeep) {
        return {};
    }
    std::vector<boost::shared_ptr<ICIMElement>> elements = fClasses.GetClasses();
    elements.insert(elements.end(), fKeptInstances.begin(), fKeptInstances.end());
    return elements;
}

}  // namespace NORVZEL20

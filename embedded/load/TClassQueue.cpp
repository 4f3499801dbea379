// Declaring classes that come in any order.
//
// A class can be declared only after its superclass, but documents may list them the other way round. So a class is queued (new)
// when it is read. When an instance needs a class, or the document ends, the new ones are tried in the document's order: from a
// class upwards through the queue until a superclass is declared (or the class has none), then downwards, declaring each. If the
// chain ends at a superclass that nobody knows yet, all of it is stuck.
//
// Stuck classes are not tried again for every instance, which would take time in proportion to classes times instances. They
// become new again only when an instance needs that very class, and when the document ends.
#include "embedded/load/TClassQueue.h"

#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/load/TClassMaker.h"
#include "embedded/load/TStoredObjects.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

namespace {

/// Whether the namespace declares the class as the draft does, apart from what both inherit.
bool IsDeclaredSo(const TInMemClass& cls, const TDraft& draft)
{
    return TStoredObjects::FromClass(cls) == TStoredObjects::WithoutInherited(draft.object, cls.GetSuperInMemClass().get());
}

}  // namespace

void TClassQueue::Add(TDraft draft)
{
    const std::string& name = draft.object.GetClassName();
    const auto repeated = fNumbers.find(name);
    if (repeated != fNumbers.end()) {
        if (fEntries[repeated->second].draft.object == draft.object) {
            return NoteRepeated(name);
        }
        fRepeated.push_back(std::move(draft));
        return;
    }
    if (const boost::shared_ptr<TInMemClass> known = fNamespace.FindClass(name)) {
        if (!IsDeclaredSo(*known, draft)) {
            fContext.Fail(EStatus::kAlreadyExists, "found class " + Quote(name) +
                                                       ", which the namespace declares differently; load into an empty namespace");
        }
        return fContext.Tolerate("known class", "class " + Quote(name) + " is in the namespace already, declared the same");
    }
    fNumbers.emplace(name, fEntries.size());
    fEntries.push_back({std::move(draft), kNew, false});
    ++fContext.GetReport().classes;
}

void TClassQueue::NoteRepeated(const std::string& name)
{
    fContext.Tolerate("repeated class", "class " + Quote(name) + " is declared again; the first declaration stands");
}

/// Two declarations can be compared only when the class has its superclass, because one may repeat what it inherits.
void TClassQueue::CheckRepeated()
{
    for (const TDraft& draft : std::exchange(fRepeated, {})) {
        const TLoadContext::TAt at(fContext, draft.place);
        const std::string& name = draft.object.GetClassName();
        if (!IsDeclaredSo(*fNamespace.FindClass(name), draft)) {
            const TLoadPlace& first = fEntries[fNumbers.find(name)->second].draft.place;
            fContext.Fail(EStatus::kAlreadyExists, "found class " + Quote(name) + " a second time, declared differently at " +
                                                       fContext.Describe(first) + "; remove one of the two");
        }
        NoteRepeated(name);
    }
}

boost::shared_ptr<TInMemClass> TClassQueue::Find(const char* name)
{
    boost::shared_ptr<TInMemClass> cls = fNamespace.FindClass(name);
    if (!cls) {
        DeclareNew();
        DeclareStuck(name);
        cls = fNamespace.FindClass(name);
    }
    while (fHasEnded && !cls && TakeMissing(name)) {
        DeclareStuck(name);
        cls = fNamespace.FindClass(name);
    }
    return cls;
}

/// Those that the documents have not declared; by now they have all been read.
void TClassQueue::DeclareQualifiersOfSchema()
{
    if (fHasTakenFromSchema) {
        return;
    }
    fHasTakenFromSchema = true;
    for (const boost::shared_ptr<TInMemQualifierDecl>& decl : fContext.GetOptions().schema->GetQualifierDecls()) {
        if (!fNamespace.FindQualifierDecl(decl->GetName())) {
            fStaging.AddQualifierDecl(decl);  // immutable, and so it may be shared
        }
    }
}

/// Queues the class as the schema declares it. Returns false if there is no schema, or no such class in it.
bool TClassQueue::TakeFromSchema(const std::string& name)
{
    const boost::shared_ptr<const TInMemNamespace>& schema = fContext.GetOptions().schema;
    const boost::shared_ptr<TInMemClass> cls = schema ? schema->FindClass(name) : boost::shared_ptr<TInMemClass>();
    if (!cls) {
        return false;
    }
    DeclareQualifiersOfSchema();
    TDraft draft{TStoredObjects::FromClass(*cls), fContext.GetPlace(), {}, {}};
    draft.propertyPlaces.assign(draft.object.GetProperties().size(), draft.place);
    fNumbers.emplace(draft.object.GetClassName(), fEntries.size());
    fEntries.push_back({std::move(draft), kStuck, true});
    ++fContext.GetReport().classes;
    return true;
}

/// Takes the class, or the first one above it that nobody has declared, from the schema. Returns false if it does not have it.
bool TClassQueue::TakeMissing(const std::string& name)
{
    std::string missing = name;
    for (std::size_t steps = 0; steps <= fEntries.size() && !missing.empty(); ++steps) {
        const auto waiting = fNumbers.find(missing);
        if (waiting == fNumbers.end()) {
            return !fNamespace.FindClass(missing) && TakeFromSchema(missing);
        }
        missing = fEntries[waiting->second].draft.object.GetSuperClassName();
    }
    return false;
}

void TClassQueue::DeclareNew()
{
    for (; fFirstNew < fEntries.size(); ++fFirstNew) {
        Declare(fFirstNew);
    }
}

/// Tries a stuck class again, because its superclass may have come meanwhile.
void TClassQueue::DeclareStuck(const char* name)
{
    const auto known = fNumbers.find(name);
    if (known == fNumbers.end()) {
        return;
    }
    for (std::size_t next = known->second; fEntries[next].state == kStuck;) {
        fEntries[next].state = kNew;
        const auto super = fNumbers.find(fEntries[next].draft.object.GetSuperClassName());
        if (super != fNumbers.end()) {
            next = super->second;
        }
    }
    Declare(known->second);
}

/// The class and those of its superclasses that are new, upwards; `super` is what is declared above them.
std::vector<std::size_t> TClassQueue::CollectChain(std::size_t number, boost::shared_ptr<TInMemClass>& super)
{
    std::vector<std::size_t> chain;
    for (std::size_t next = number; fEntries[next].state == kNew;) {
        ++fTried;
        fEntries[next].state = kVisited;
        chain.push_back(next);
        const std::string& superName = fEntries[next].draft.object.GetSuperClassName();
        super = fNamespace.FindClass(superName);
        const auto waiting = fNumbers.find(superName);
        if (superName.empty() || super || waiting == fNumbers.end()) {
            break;
        }
        next = waiting->second;
    }
    return chain;
}

/// Declares a class after those of its superclasses that wait, or none of them if the topmost is not known yet.
void TClassQueue::Declare(std::size_t number)
{
    ++fTried;
    boost::shared_ptr<TInMemClass> super;
    for (std::vector<std::size_t> chain = CollectChain(number, super); !chain.empty(); chain.pop_back()) {
        TEntry& entry = fEntries[chain.back()];
        entry.state = kStuck;
        if (!super && !entry.draft.object.GetSuperClassName().empty()) {
            continue;
        }
        const TLoadContext::TAt at(fContext, entry.draft.place);
        fContext.Guard([&] {
            super = TClassMaker(fContext, fNamespace, entry.isOfSchema).Make(entry.draft, super);
            fStaging.AddClass(super);
        });
        entry.state = kDeclared;
        ++fDeclared;
    }
}

void TClassQueue::DeclareAll()
{
    fHasEnded = true;
    for (std::size_t i = 0; i < fEntries.size(); ++i) {  // taking a class adds an entry
        const std::string superName = fEntries[i].draft.object.GetSuperClassName();
        if (!superName.empty() && fNumbers.count(superName) == 0 && !fNamespace.FindClass(superName)) {
            TakeFromSchema(superName);
        }
    }
    for (TEntry& entry : fEntries) {
        if (entry.state == kStuck) {
            entry.state = kNew;
        }
    }
    fFirstNew = 0;
    DeclareNew();
    for (const TEntry& entry : fEntries) {
        if (entry.state != kDeclared) {
            Refuse(entry.draft);
        }
    }
    CheckRepeated();
}

void TClassQueue::MakeDefaultsLocal()
{
    if (!fContext.GetOwnPlace().HasOpen()) {
        return;
    }
    for (const TEntry& entry : fEntries) {
        const boost::shared_ptr<TInMemClass> cls = fNamespace.FindClass(entry.draft.object.GetClassName());
        for (const boost::shared_ptr<TInMemPropertyDecl>& decl : cls->GetLayout().GetOwnDecls()) {
            TCIMValue value = decl->GetDefaultValue();
            fContext.GetOwnPlace().MakeLocal(value);
            decl->RewriteDefault(value);
        }
    }
}

void TClassQueue::Refuse(const TDraft& draft) const
{
    const TLoadContext::TAt at(fContext, draft.place);
    const std::string& superName = draft.object.GetSuperClassName();
    const std::string found = "found class " + Quote(draft.object.GetClassName()) + " with the superclass " + Quote(superName);
    if (fNumbers.count(superName) > 0) {
        fContext.Fail(EStatus::kNotFound, found + ", which leads back to it or to a class that is not declared");
    }
    fContext.Fail(EStatus::kNotFound, found + fContext.DescribeUndeclared(), EAdvice::kGiveDeclaration);
}

std::vector<boost::shared_ptr<ICIMElement>> TClassQueue::GetClasses() const
{
    std::vector<boost::shared_ptr<ICIMElement>> classes;
    for (const TEntry& entry : fEntries) {
        classes.push_back(fNamespace.FindClass(entry.draft.object.GetClassName()));
    }
    return classes;
}

}  // namespace NORVZEL20

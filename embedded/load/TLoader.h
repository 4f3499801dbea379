#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <utility>
#include <vector>

#include "embedded/load/TClassQueue.h"
#include "embedded/load/TDraft.h"
#include "embedded/load/TInstanceBuilder.h"
#include "embedded/load/TLateInstances.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TQualifierDraft.h"
#include "embedded/load/TRepeatedInstances.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TInMemStaging.h"
#include "host/Export.h"
#include "host/ICIMElement.h"

namespace NORVZEL20 {

/// Adds what a document describes to a namespace: all of it, or nothing.
///
/// Until Commit is called, the destructor takes everything out again. Classes may come in any order, and instances before the
/// classes that they need. Instances of a class are added in the document's order.
/// Errors: every operation but Commit fails through the context. Threads: as the namespace.
class CIMDELTA_INTERNAL_EXPORT TLoader {
  public:
    using TOwnKeys = TInstanceBuilder::TOwnKeys;
    using TReadObjects = TInstanceBuilder::TReadObjects;

    /// `context` must outlive the loader; `ns` must not be null.
    TLoader(TLoadContext& context, const boost::shared_ptr<TInMemNamespace>& ns);
    ~TLoader();

    /// A repeated declaration is tolerated if it has the same type and value. Errors: kAlreadyExists (12) if it has not.
    void AddQualifierDecl(const TQualifierDraft& draft);
    /// See TClassQueue::Add.
    void AddClass(TDraft draft);

    /// Starts an instance. If it returns false, read the instance as a draft and call AddInstance; otherwise call FindProperty or
    /// TakeLikely, and SetProperty or FillProperty, for each of its properties (see TInstanceBuilder), then EndInstance.
    bool BeginInstance(const char* className);
    TLoadTarget& FindProperty(const char* name) { return fBuilder.FindProperty(name); }
    TLoadTarget* TakeLikely(std::uint64_t tagNumber) noexcept { return fBuilder.TakeLikely(tagNumber); }
    bool FillProperty(const TLoadTarget& target, TCIMValue& value) noexcept { return fBuilder.FillProperty(target, value); }
    void SetProperty(const TLoadTarget& target, TCIMValue&& value, bool isUnsettled)
    {
        fBuilder.SetProperty(target, std::move(value), isUnsettled);
    }
    void SetBad(const TLoadTarget& target, const TBadValue& bad) { fBuilder.SetBad(target, bad); }
    /// `ownKeys` (may be null) gives the keys of the name in front of the instance; it may leave them out itself. Errors:
    /// kAlreadyExists (12) if an instance with these keys was there before the load, kKeyMissing (14) if a key has no value,
    /// kParseError (9) if the name has other keys than the class, or other values than the instance.
    void EndInstance(const TOwnKeys* ownKeys);
    void AddInstance(TDraft draft);
    /// As AddInstance, but does not let the instance wait if no other does. Call it after DeclareClasses. Errors: as Finish.
    void FillInstance(TDraft draft, const TReadObjects& readObjects);

    /// The class of that name, for parts that need it before Finish; null if neither the documents nor the schema of the load have
    /// it. Errors: those of TClassQueue::Find.
    boost::shared_ptr<TInMemClass> FindClass(const std::string& name) { return fClasses.Find(name.c_str()); }
    /// Declares the classes that wait. Call it at the end of the documents, if something needs the classes before Finish. Errors:
    /// as Finish.
    void DeclareClasses() { fClasses.DeclareAll(); }
    /// Adds what waits. Call it at the end of the documents. Errors: kNotFound (15) for a class that never came, kAlreadyExists
    /// (12) if a class or an instance came twice with different contents, and those of the others.
    void Finish(const TReadObjects& readObjects);
    /// Keeps what was added.
    void Commit() noexcept;

    /// From now on remembers the instances, for TakeElements.
    void KeepElements() { fKeep = true; }
    /// Classes, then instances, each in the document's order; empty without KeepElements. Call it after Finish.
    std::vector<boost::shared_ptr<ICIMElement>> TakeElements();

    /// See TClassQueue::CountTried.
    std::size_t CountTried() const noexcept { return fClasses.CountTried(); }

  private:
    void Fill(const TDraft& draft, const TReadObjects& readObjects);
    void InferClasses();
    void DeclareQualifier(const TQualifierDraft& draft);
    void Add(const boost::shared_ptr<TInMemInstance>& instance);
    void DropRepeated();
    [[noreturn]] void Explain(const TZELException& error, const TInMemInstance& instance) const;

    TLoadContext& fContext;
    boost::shared_ptr<TInMemNamespace> fNamespace;
    TInMemStaging fStaging;
    TClassQueue fClasses;
    TLateInstances fLate;
    TRepeatedInstances fRepeats;
    TInstanceBuilder fBuilder;
    bool fHasEnded = false;  // the document: instances are held until it is decided which references are local
    TOwnPlace fOwnPlace;     // of the document, when it has ended
    bool fKeep = false;
    std::vector<boost::shared_ptr<ICIMElement>> fKeptInstances;
};

}  // namespace NORVZEL20

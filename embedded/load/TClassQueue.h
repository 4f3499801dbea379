#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <vector>

#include "embedded/load/TDraft.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TInMemStaging.h"
#include "embedded/value/TNameText.h"
#include "host/Export.h"
#include "host/ICIMElement.h"

namespace NORVZEL20 {

/// The classes that a document declares. They may come in any order: each waits until it is needed or the document ends.
///
/// Errors: every operation but the counts fails through the context, at the place of the class concerned.
class CIMDELTA_INTERNAL_EXPORT TClassQueue {
  public:
    /// All arguments must outlive the queue. `staging` is one of `ns`.
    TClassQueue(TLoadContext& context, TInMemNamespace& ns, TInMemStaging& staging) noexcept
        : fContext(context), fNamespace(ns), fStaging(staging)
    {}

    /// Queues a class. One that is declared already, here or in the namespace, is tolerated and left out if both declarations are
    /// the same; what they inherit does not count. Errors: kAlreadyExists (12) if they differ. For two declarations of the load,
    /// this may turn out only in DeclareAll.
    void Add(TDraft draft);

    /// The class of that name, declared now if it is in the queue; null if it or one of its superclasses is not known yet. After
    /// DeclareAll, what nobody has declared is taken from the schema of the load (see TLoadOptions).
    /// Cost: constant for a class of the namespace; each class in the queue is tried a bounded number of times, however often this
    /// is called. Errors: those of TClassMaker.
    boost::shared_ptr<TInMemClass> Find(const char* name);

    /// Declares all classes that wait. Call it at the end of the document. Errors: kNotFound (15) for a class whose superclass
    /// never came, or which is below itself; those of TClassMaker.
    void DeclareAll();

    /// Takes the document's own namespace out of the references in default values. Call it after TOwnPlaceSearch::Decide.
    void MakeDefaultsLocal();

    /// How many classes have been declared.
    std::size_t CountDeclared() const noexcept { return fDeclared; }
    /// How often classes were looked at in order to declare them, for callers that bound the work.
    std::size_t CountTried() const noexcept { return fTried; }
    /// The declared classes in the document's order. Call it after DeclareAll.
    std::vector<boost::shared_ptr<ICIMElement>> GetClasses() const;

  private:
    enum EState : unsigned char {
        kNew,      ///< not tried yet
        kVisited,  ///< being tried
        kStuck,    ///< tried while its topmost superclass was not known
        kDeclared
    };

    struct TEntry {
        TDraft draft;
        EState state;
        bool isOfSchema;  ///< whether it was taken from there
    };

    void NoteRepeated(const std::string& name);
    void CheckRepeated();
    void DeclareQualifiersOfSchema();
    bool TakeFromSchema(const std::string& name);
    bool TakeMissing(const std::string& name);
    void DeclareNew();
    void DeclareStuck(const char* name);
    void Declare(std::size_t number);
    std::vector<std::size_t> CollectChain(std::size_t number, boost::shared_ptr<TInMemClass>& super);
    [[noreturn]] void Refuse(const TDraft& draft) const;

    TLoadContext& fContext;
    TInMemNamespace& fNamespace;
    TInMemStaging& fStaging;
    std::vector<TEntry> fEntries;    // in the document's order
    TNameMap<std::size_t> fNumbers;  // of the entries, by class name
    std::vector<TDraft> fRepeated;  // declarations of classes that differ from those in fEntries, perhaps only in what they inherit
    std::size_t fFirstNew = 0;      // entries in front of it have been tried
    std::size_t fDeclared = 0;
    bool fHasEnded = false;  // all documents have been read
    bool fHasTakenFromSchema = false;
    std::size_t fTried = 0;
};

}  // namespace NORVZEL20

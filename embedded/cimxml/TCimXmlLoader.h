#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "embedded/cimxml/TCimXmlContext.h"
#include "embedded/cimxml/TCimXmlDraft.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TInMemStaging.h"
#include "embedded/value/TNameText.h"
#include "host/ICIMElement.h"

namespace NORVZEL20 {

/// Makes what a document tells part of a namespace: all of it, or nothing.
///
/// Classes wait until they are needed or the document ends, so that they may come in any order. An instance is filled directly,
/// property by property, where its class is known; otherwise it waits as a draft until the document ends, and so do those after it.
/// One whose keys refer to a class that is not known yet is filled but waits too, and so do those of its class after it: what it is
/// called depends on that class.
/// Errors: every operation but Commit fails through the context.
class TCimXmlLoader {
  public:
    using TOwnKeys = std::vector<std::pair<std::string, TCIMValue>>;
    /// Reads those texts of a value that are embedded objects.
    using TReadObjects = boost::function<TCIMValue(const TCIMValue&)>;

    /// A property of the instance being filled.
    struct TTarget {
        const std::string* name;  ///< as declared
        std::uint32_t slot;
        TCIMValue::TCIMType type;
        bool isEmbedded;  ///< whether text may be an embedded object, as the declaration says
    };

    TCimXmlLoader(TCimXmlContext& context, boost::shared_ptr<TInMemNamespace> ns);

    void AddQualifierDecl(const TCimXmlQualifierDraft& draft);
    void AddClass(TCimXmlDraft draft);

    /// False where the instance has to be read as a draft.
    bool BeginInstance(const char* className);
    TTarget FindProperty(const char* name);
    /// `metUnknownClass` tells that the value refers to a class that is not known yet.
    void SetProperty(const TTarget& target, TCIMValue&& value, bool metUnknownClass);
    /// `ownKeys` (may be null) fills the keys that the instance itself does not tell.
    void EndInstance(const TOwnKeys* ownKeys);
    void AddInstance(TCimXmlDraft draft);

    /// The document has ended: adds what waits.
    void Finish(const TReadObjects& readObjects);
    void Commit() noexcept { fStaging.Commit(); }

    void KeepElements() { fKeep = true; }
    /// How often classes were looked at in order to declare them, for those who bound the work.
    std::size_t CountTried() const noexcept { return fTried; }
    /// Classes, then instances, each in the document's order; empty without KeepElements.
    std::vector<boost::shared_ptr<ICIMElement>> TakeElements();

  private:
    struct TClassDraft {
        enum EState { kNew, kVisited, kStuck, kDeclared };  ///< stuck: tried when its topmost superclass was not known

        TCimXmlDraft draft;
        EState state;
    };

    /// What is known of a class whose instances are read; vectors go by slot.
    struct TLayout {
        boost::shared_ptr<TInMemClass> cls;
        std::vector<bool> embedded;            // see TTarget
        std::vector<std::uint32_t> positions;  // in order of declaration
        std::vector<std::uint32_t> given;      // the number of the last instance that told it
        bool isHeld = false;                   // its instances wait
    };

    struct THeld {
        boost::shared_ptr<TInMemInstance> instance;
        TCimXmlContext::TPlace place;
    };

    void DeclareClasses();
    void DeclareClass(std::size_t number);
    void DeclareStuck(const char* className);
    std::vector<std::size_t> CollectChain(std::size_t number, boost::shared_ptr<TInMemClass>& super);
    [[noreturn]] void RefuseClass(const TCimXmlDraft& draft) const;
    TLayout* FindLayout(const char* className);
    TLayout* AddLayout(const char* className, const boost::shared_ptr<TInMemClass>& cls);
    void BeginInstance(TLayout& layout);
    TCIMValue Convert(const TTarget& target, const TCIMValue& value);
    void FillKeys(const TOwnKeys& keys);
    void Add(const boost::shared_ptr<TInMemInstance>& instance);
    [[noreturn]] void Explain(const TZELException& error, const TInMemInstance& instance) const;
    void AddHeld();
    void AddWaiting(const TCimXmlDraft& draft, const TReadObjects& readObjects);
    void ResolveReferences();

    TCimXmlContext& fContext;
    boost::shared_ptr<TInMemNamespace> fNamespace;
    TInMemStaging fStaging;
    std::vector<TClassDraft> fClasses;
    TNameMap<std::size_t> fClassNumbers;
    std::size_t fFirstNew = 0;  // of fClasses, that has not been tried yet
    std::size_t fTried = 0;
    std::vector<THeld> fHeld;                     // instances
    std::vector<TCimXmlDraft> fWaiting;           // instances
    TNameMap<std::unique_ptr<TLayout>> fLayouts;  // by class name
    TLayout* fLayout = nullptr;                   // of the instance being filled, or the last one
    boost::shared_ptr<TInMemInstance> fInstance;
    std::uint32_t fNumber = 0;  // of the instance
    std::size_t fExpected = 0;  // the position of the property that is likely to come next
    std::vector<std::pair<boost::shared_ptr<TInMemInstance>, std::uint32_t>> fUnresolved;
    bool fMustHold = false;      // a key of the instance refers to a class that is not known yet
    bool fDeferring = false;     // instances wait
    bool fEnded = false;         // all classes are known, or will never be
    bool fDeclaredLate = false;  // a class was declared after the first instance
    bool fKeep = false;
    std::vector<boost::shared_ptr<ICIMElement>> fKeptInstances;
};

}  // namespace NORVZEL20

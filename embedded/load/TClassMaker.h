#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "embedded/load/TDraft.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Makes classes from their drafts.
///
/// A part that a document repeats from the superclass (PROPAGATED) is left out if it says what the superclass says, and so is
/// inherited. If it says anything else, it is an override.
/// Qualifiers without a declaration, and restated ones with another flavor, are tolerated.
/// Errors: fails through the context with kParseError (9) if a name cannot stand in a path, a part is declared twice or the class
/// would exceed TSchemaLimits, with kTypeMismatch (13) if a property has another type than in a superclass.
class TClassMaker {
  public:
    /// `ns` is what the class is for. It and the context must outlive the maker. `isKnown` says that the class was loaded before,
    /// as a part of the schema: what is tolerated in it is in the report of that load already.
    TClassMaker(TLoadContext& context, TInMemNamespace& ns, bool isKnown) : fContext(context), fNamespace(ns), fIsKnown(isKnown) {}

    /// A class that is not added to the namespace yet; `super` is null for a top-level class.
    boost::shared_ptr<TInMemClass> Make(const TDraft& draft, const boost::shared_ptr<TInMemClass>& super);

  private:
    using TQualifiers = std::vector<TEmbeddedObject::TQualifier>;

    template <class TElement>
    void AddQualifiers(TElement& element, const TQualifiers& qualifiers, const TInMemQualifierSet* inherited);
    [[noreturn]] void FailTooMany(std::size_t most, const char* what, const std::string& className) const;
    [[noreturn]] void FailSecond(const char* what, const std::string& name, const TInMemClass& cls) const;
    void NoteQualifier(const TEmbeddedObject::TQualifier& qualifier, const ICIMQualifier* inherited);
    void AddProperty(TInMemClass& cls, const TEmbeddedObject::TProperty& property, const TInMemClass* super);
    void DeclareProperty(TInMemClass& cls, const TEmbeddedObject::TProperty& property, const TInMemPropertyDecl* inherited);
    void AddMethod(TInMemClass& cls, const TEmbeddedObject::TMethod& method, const TInMemClass* super);
    void DeclareMethod(TInMemClass& cls, const TEmbeddedObject::TMethod& method, const TInMemMethodDecl* inherited);

    TLoadContext& fContext;
    TInMemNamespace& fNamespace;
    bool fIsKnown;
};

}  // namespace NORVZEL20

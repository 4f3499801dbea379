#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "embedded/cimxml/TCimXmlContext.h"
#include "embedded/cimxml/TCimXmlDraft.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Makes classes from what documents tell of them.
///
/// Elements that a document repeats from a superclass (PROPAGATED) are left to be inherited where the superclass has them.
/// Qualifiers without a declaration, and restated ones with another flavor, are put up with. Errors: every operation fails through
/// the context, also where a class would go beyond TSchemaLimits.
class TCimXmlClassMaker {
  public:
    TCimXmlClassMaker(TCimXmlContext& context, TInMemNamespace& ns) : fContext(context), fNamespace(ns) {}

    /// A class that is not added yet; `super` is null for a top-level class.
    boost::shared_ptr<TInMemClass> Make(const TCimXmlDraft& draft, const boost::shared_ptr<TInMemClass>& super);

  private:
    using TQualifiers = std::vector<TEmbeddedObject::TQualifier>;

    template <class TElement>
    void AddQualifiers(TElement& element, const TQualifiers& qualifiers, const TInMemQualifierSet* inherited);
    [[noreturn]] void FailTooMany(std::size_t most, const char* what, const std::string& className) const;
    void NoteQualifier(const TEmbeddedObject::TQualifier& qualifier, const ICIMQualifier* inherited);
    void AddProperty(TInMemClass& cls, const TEmbeddedObject::TProperty& property, const TInMemClass* super);
    void AddMethod(TInMemClass& cls, const TEmbeddedObject::TMethod& method, const TInMemClass* super);

    TCimXmlContext& fContext;
    TInMemNamespace& fNamespace;
};

}  // namespace NORVZEL20

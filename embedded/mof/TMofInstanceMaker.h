#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <optional>
#include <string_view>
#include <vector>

#include "embedded/load/TDraft.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/mof/IMofSink.h"
#include "embedded/mof/TMofAliases.h"
#include "embedded/mof/TMofInstance.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Makes drafts of instances when all classes are declared: values get their declared types, aliases become references.
///
/// What the class does not declare keeps the type that its form suggests; the loader decides about it.
/// The text of an embedded object that cannot be read is a bad value, as in TInstanceBuilder.
/// Errors: fails through the context as TMofAliases, and with kTypeMismatch (13) for an array whose elements have no type in
/// common.
class TMofInstanceMaker {
  public:
    /// `sink` knows the qualifiers; `instances`: see TMofAliases. All arguments must outlive the maker, but the vector need not.
    TMofInstanceMaker(TLoadContext& context, const TInMemNamespace& ns, IMofSink& sink,
                      const std::vector<const TMofInstance*>& instances);

    TDraft Make(const TMofInstance& instance);

  private:
    TCIMValue Resolve(const TMofValue& value);
    TCIMValue ReadValue(const TInMemPropertyDecl* decl, const TMofInstance::TProperty& property, std::optional<TBadValue>& bad);
    TCIMValue ReadObjects(const TCIMValue& value, std::optional<TBadValue>& bad);
    TCIMValue ReadElements(const TCIMValue& value);
    boost::shared_ptr<const TEmbeddedObject> ReadObjectText(std::string_view text);
    TEmbeddedObject MakeObject(const TMofInstance& instance);

    TLoadContext& fContext;
    const TInMemNamespace& fNamespace;
    IMofSink& fSink;
    TMofTyping::TResolve fResolve;
    TMofAliases fAliases;
};

}  // namespace NORVZEL20

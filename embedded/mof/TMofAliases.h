#pragma once

#include <string>
#include <vector>

#include "embedded/load/TLoadContext.h"
#include "embedded/mof/TMofInstance.h"
#include "embedded/mof/TMofTyping.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// The instances that have an alias, and the references that the aliases stand for.
///
/// Errors: every operation fails through the context.
class TMofAliases {
  public:
    /// `instances` have aliases; one may come several times. `resolve` reads aliases and instances in keys. All arguments must
    /// outlive this, but the vector need not. Errors: kParseError (9) if two instances have one alias.
    TMofAliases(TLoadContext& context, const TInMemNamespace& ns, const std::vector<const TMofInstance*>& instances,
                TMofTyping::TResolve resolve);

    /// The path of the instance with that alias. Errors: kNotFound (15) if there is none or its class is not declared; kParseError
    /// (9) if it refers to itself through its keys, or too deeply; kKeyMissing (14) if it has no value for a key; kTypeMismatch
    /// (13) if a value is not of its key's type.
    const TCIMValue& GetReference(const std::string& alias);

  private:
    struct TEntry {
        const TMofInstance* instance = nullptr;
        bool isOpen = false;  // its reference is being made
        TCIMValue reference;  // null if it has not been made yet
    };
    class TOpen;

    TCIMValue MakeReference(const TMofInstance& instance);
    TCIMValue ReadKey(const TMofInstance& instance, const TInMemPropertyDecl& decl);

    TLoadContext& fContext;
    const TInMemNamespace& fNamespace;
    TMofTyping::TResolve fResolve;
    TNameMap<TEntry> fEntries;
    std::size_t fDepth = 0;
};

}  // namespace NORVZEL20

#pragma once

#include <boost/function.hpp>
#include <string>

#include "embedded/load/TLoadContext.h"
#include "embedded/mof/TMofValue.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Gives values types.
class TMofTyping {
  public:
    TMofTyping() = delete;

    /// Returns what an alias or an instance in a value stands for.
    using TResolve = boost::function<TCIMValue(const TMofValue&)>;

    /// The value in the type `type`, as MOF spells values of that type. Returns false, and leaves `result` as it is, if it has
    /// another form or does not fit. What `resolve` throws passes.
    static bool Read(const TMofValue& value, TCIMValue::TCIMType type, const TResolve& resolve, TCIMValue& result);

    /// The value in the type that its form suggests: string, boolean, uint64, or sint64 if it is negative, real64, char16; for an
    /// array the first of these that all elements fit in. A null is one without a type. Returns false if the elements of an array
    /// have no type in common.
    static bool Guess(const TMofValue& value, const TResolve& resolve, TCIMValue& result);

    /// The value of something that is declared with a type: as Read, or else converted by TValueText::Convert, which the report
    /// notes. `what` names it for messages, such as `qualifier "MaxLen"`. Aliases and instances do not fit. Errors: fails with
    /// kTypeMismatch (13) if it does not fit.
    static TCIMValue ReadDeclared(TLoadContext& context, const std::string& what, const TMofValue& value, TCIMValue::TCIMType type);

    /// The value for people: as it is written, shortened.
    static std::string Describe(const TMofValue& value);
};

}  // namespace NORVZEL20

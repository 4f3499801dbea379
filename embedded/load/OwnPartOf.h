#pragma once

#include <optional>

#include "embedded/store/TInMemMethodDecl.h"
#include "embedded/store/TInMemPropertyDecl.h"
#include "embedded/store/TInMemQualifierSet.h"
#include "embedded/value/TEmbeddedObject.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Whether the qualifier repeats one of `above`, the qualifiers of the element that is inherited (null for none): it is marked as
/// propagated, and that one is inherited (ToSubclass) and has the same type and value.
bool IsInherited(const TEmbeddedObject::TQualifier& qualifier, const TInMemQualifierSet* above);

/// What a class declares itself, if the document marks the property as propagated: null if it says nothing else than `above`, which
/// the class inherits. Otherwise it is an override: without a default if it writes none; if it leaves out the class of the
/// reference or the size of the array, that is as inherited.
std::optional<TEmbeddedObject::TProperty> OwnPartOf(const TEmbeddedObject::TProperty& property, const TInMemPropertyDecl& above);
/// The same for a method; one without parameters has the inherited ones.
std::optional<TEmbeddedObject::TMethod> OwnPartOf(const TEmbeddedObject::TMethod& method, const TInMemMethodDecl& above);

}  // namespace NORVZEL20

#pragma once

namespace NORVZEL20 {

class ICIMClass;
class TInMemClass;
class TInMemPropertyDecl;

// What must hold before a class is changed.

/// Checks that `decl` may be added to `cls`. Errors: kTypeMismatch (13) if an ancestor or a class below declares a property of that
/// name with another type. Cost: one look-up for each class below.
void CheckTypeFits(const TInMemClass& cls, const TInMemPropertyDecl& decl);

/// Checks that `decl`, which `cls` declares, may cease to be a key or be removed. Errors: kClassInUse (19) if `cls` or a class
/// below has instances and would lose the key, because instances might then have equal keys. Cost: one look-up for each class
/// below.
void CheckKeyStays(const TInMemClass& cls, const TInMemPropertyDecl& decl);

/// Checks that the properties and methods that both classes have are of the same types. `source` may be a class of any host.
/// Errors: kTypeMismatch (13).
void CheckTypesAgree(const ICIMClass& source, const TInMemClass& target);

}  // namespace NORVZEL20

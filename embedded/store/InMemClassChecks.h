#pragma once

namespace NORVZEL20 {

class TInMemClass;
class TInMemPropertyDecl;

/// What must hold before the properties of a class with classes below it are changed. Cost: one look-up for each of them.

/// Returns if `decl` may be added to `cls`. Errors: kTypeMismatch (13) if an ancestor or a class below declares a property of that
/// name with another type.
void CheckTypeFits(const TInMemClass& cls, const TInMemPropertyDecl& decl);

/// Returns if `decl`, which `cls` declares, may cease to be a key or go. Errors: kClassInUse (19) if `cls` or a class below has
/// instances and would lose the key: instances are told apart by their keys.
void CheckKeyStays(const TInMemClass& cls, const TInMemPropertyDecl& decl);

}  // namespace NORVZEL20

#pragma once

#include <string>
#include <vector>

#include "embedded/store/TInMemNamespace.h"
#include "host/Export.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// Writes references as the classes of a namespace declare them: with the class itself, its keys spelled and typed as declared.
///
/// For references made before their class was declared, or before a name got another letter case. Those within keys, arrays and
/// embedded objects are adapted too.
class CIMDELTA_INTERNAL_EXPORT TReferenceAdapter {
  public:
    /// `ns` must outlive this.
    explicit TReferenceAdapter(const TInMemNamespace& ns) noexcept : fNamespace(ns) {}

    /// Gives a key of a path its declared spelling, and its declared type where that loses nothing. Returns the declaration; null
    /// where `cls` has no property of that name, and the key is left alone.
    static const TInMemPropertyDecl* AdaptKey(const TInMemClass& cls, std::string& name, TCIMValue& value);

    /// Adapts the references in `value`; false where it was as declared, and is left alone.
    bool Adapt(TCIMValue& value) const;

    /// Adapts what the instances and static properties of `ns` hold; keys too, under which the instances are then found. Returns
    /// the path of an instance that is then there twice, because two keys that differed are the same as declared; else nothing.
    /// Cost: one pass over all values that may hold a reference.
    static std::string AdaptAll(TInMemNamespace& ns);

  private:
    bool AdaptPath(TCIMValue& value) const;
    bool AdaptElements(TCIMValue& value) const;
    bool AdaptObject(TCIMValue& value) const;
    bool AdaptInstance(TInMemInstance& instance, const std::vector<std::uint32_t>& slots) const;
    void AdaptStatics(const TInMemClass& cls) const;

    const TInMemNamespace& fNamespace;
};

}  // namespace NORVZEL20

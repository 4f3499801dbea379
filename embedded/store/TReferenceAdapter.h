#pragma once

#include <string>
#include <vector>

#include "embedded/store/TInMemNamespace.h"
#include "host/Export.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// Brings references in line with the classes of a namespace: with the class itself, keys spelled and typed as declared.
///
/// It is meant for references that were made before their class was declared, or before a name was spelled another way. References
/// within keys, arrays and embedded objects are adapted too.
class CIMDELTA_INTERNAL_EXPORT TReferenceAdapter {
  public:
    /// `ns` must outlive this.
    explicit TReferenceAdapter(const TInMemNamespace& ns) noexcept : fNamespace(ns) {}

    /// Gives a key of a path its declared spelling, and its declared type if that loses nothing. Returns the declaration. If `cls`
    /// has no property of that name, it returns null and leaves the key alone.
    static const TInMemPropertyDecl* AdaptKey(const TInMemClass& cls, std::string& name, TCIMValue& value);

    /// Adapts the references in `value`. Returns false if nothing in it was to be changed.
    bool Adapt(TCIMValue& value) const;

    /// Adapts what the instances and static properties of `ns` hold. An instance whose keys change is found by the new ones. Two
    /// instances whose keys differed before may have the same ones then: returns the path of the first such pair, else an empty
    /// text. Cost: one pass over all values that may hold a reference.
    static std::string AdaptAndFindDuplicate(TInMemNamespace& ns);

  private:
    bool AdaptPath(TCIMValue& value) const;
    void AdaptStatics(const TInMemClass& cls) const;
    bool AdaptInstances(TInMemClass& cls) const;
    bool AdaptInstance(TInMemInstance& instance, const std::vector<std::uint32_t>& slots) const;

    const TInMemNamespace& fNamespace;
};

}  // namespace NORVZEL20

#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "embedded/store/TInMemNamespace.h"
#include "host/Export.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// Brings references in line with the classes of a namespace: with the class itself, keys spelled and typed as declared.
///
/// It is meant for references that were made before their class was declared, or before a name was spelled another way. References
/// within keys, arrays and embedded objects are adapted too. A key that nests too deeply becomes text.
class CIMDELTA_INTERNAL_EXPORT TReferenceAdapter {
  public:
    /// A reference may be a key, so its own keys leave one level for the path of its instance.
    static constexpr unsigned int kLevelsAbove = 1;

    /// References keep the namespaces that they name. `ns` must outlive this.
    /// `embeddedDepth` counts the embedded objects around the references.
    explicit TReferenceAdapter(const TInMemNamespace& ns, std::size_t embeddedDepth = 0) noexcept
        : fNamespace(ns), fEmbeddedDepth(embeddedDepth)
    {}
    /// References to `ownPlace` lose namespace and host. Both must outlive this.
    TReferenceAdapter(const TInMemNamespace& ns, const TOwnPlace& ownPlace) noexcept : fNamespace(ns), fOwnPlace(&ownPlace) {}

    /// Gives a key of a path its declared spelling, and its value as AdaptKeyValue. Returns the declaration. If `cls` has no
    /// property of that name, it returns null and leaves the key alone.
    const TInMemPropertyDecl* AdaptKey(const TInMemClass& cls, std::string& name, TCIMValue& value) const;
    /// The value of a key in its declared type if that loses nothing; text is read if it is an embedded object by its declaration.
    /// References in it are as they were written. Returns false if `value` is to stay as it is.
    bool ConvertKey(const TInMemPropertyDecl& decl, const TCIMValue& value, TCIMValue& converted) const;
    /// Converts the value of a key and adapts what it has become. Returns whether it changed.
    bool AdaptKeyValue(const TInMemPropertyDecl& decl, TCIMValue& value) const;

    /// Adapts the references in `value`. Returns false if nothing in it was to be changed.
    bool Adapt(TCIMValue& value) const;

    /// Adapts what the instances and static properties of `ns` hold, and makes references to TInMemNamespace::GetOwnPlace local. An
    /// instance whose keys change is found by the new ones. Two instances whose keys differed before may have the same ones then:
    /// returns the path of the first such pair, else an empty text. Cost: one pass over all values that may hold a reference.
    static std::string AdaptAndFindDuplicate(TInMemNamespace& ns);

  private:
    bool AdaptPath(TCIMValue& value) const;
    bool AdaptBinding(const TInMemClass* cls, std::string& name, TCIMValue& value) const;
    void AdaptStatics(const TInMemClass& cls) const;
    bool AdaptInstances(TInMemClass& cls) const;
    bool AdaptInstance(TInMemInstance& instance, const std::vector<std::uint32_t>& slots) const;

    const TInMemNamespace& fNamespace;
    std::size_t fEmbeddedDepth = 0;
    const TOwnPlace* fOwnPlace = nullptr;  // null: namespaces stay
};

}  // namespace NORVZEL20

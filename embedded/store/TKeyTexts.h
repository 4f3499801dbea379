#pragma once

#include <boost/function.hpp>
#include <string>
#include <string_view>

#include "embedded/store/TInMemNamespace.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// The texts by which the instances of a namespace are identified: keys that are text, and text in the keys of references,
/// whatever holds the reference (a property, an array, an embedded object, a key of another reference).
class CIMDELTA_INTERNAL_EXPORT TKeyTexts {
  public:
    /// Where a text stands.
    struct TPlace {
        std::string_view className;  ///< the class of the instance, also for a reference in it
        std::string_view key;        ///< the name of the key
        bool isInReference;
    };
    /// Returns what takes the text's place, or null to leave it.
    using TChange = boost::function<TCIMValue(std::string_view text, const TPlace& place)>;

    /// `ns` must outlive this.
    explicit TKeyTexts(TInMemNamespace& ns) noexcept : fNamespace(ns) {}

    /// Calls `change` for each text, and puts the texts that it returns in their places: all of them, or none. Instances stay in
    /// their order and are found by their new keys. Returns an empty text; if two instances had the same path then, nothing is
    /// changed and it returns the path. Errors: those of `change`; std::bad_alloc; nothing is changed then. Cost: one pass over
    /// the values that may hold a reference or are keys.
    std::string Change(const TChange& change);

  private:
    TInMemNamespace& fNamespace;
};

}  // namespace NORVZEL20

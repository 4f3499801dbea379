#pragma once

#include <boost/smart_ptr/weak_ptr.hpp>
#include <memory>
#include <string>

#include "embedded/value/TCounted.h"
#include "embedded/value/TKeyBindings.h"
#include "host/ICIMNamespace.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// The contents of a path. Most paths in an inventory have neither namespace nor host, so the two cost one pointer.
struct TCIMReference::TContents : TCounted {
    using TBinding = TKeyBindings::TBinding;

    struct TPlace {
        boost::weak_ptr<ICIMNamespace> ns;
        std::string namespaceName;
        std::string host;
    };

    // Each level doubles the backslashes of the level within: without a bound, the text of a deep path would fill any memory.
    static constexpr unsigned int kMaxDepth = 12;

    TContents() = default;
    TContents(const TContents& other)
        : TCounted(), place(other.place ? std::make_unique<TPlace>(*other.place) : nullptr), cls(other.cls),
          bindings(other.bindings), depth(other.depth)
    {}

    /// Contents of an empty path, new or recycled, with one use. Errors: std::bad_alloc.
    static TContents* Make();
    /// Gives up one use.
    static void Drop(TContents* contents) noexcept;
    /// Frees what this thread keeps of paths that have ended.
    static void FreeSpares() noexcept;

    TPlace& OwnPlace()
    {
        if (!place) {
            place = std::make_unique<TPlace>();
        }
        return *place;
    }

    /// Gives the memory of a place back that says nothing.
    void DropEmptyPlace() noexcept
    {
        if (place && place->namespaceName.empty() && place->host.empty() && place->ns.expired()) {
            place.reset();
        }
    }

    /// How deep references are nested in `value`; 0 if there is none.
    static unsigned int GetDepth(const TCIMValue& value);

    struct TSpares;
    struct TSparesEnd;

    std::unique_ptr<TPlace> place;  // null: no namespace and no host
    boost::shared_ptr<ICIMClass> cls;
    TKeyBindings bindings;   // in the order of the names in lower case
    unsigned int depth = 0;  // how deep references are nested in the bindings
};

}  // namespace NORVZEL20

#pragma once

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>
#include <memory>
#include <string>
#include <vector>

#include "embedded/value/TCounted.h"
#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// What the paths to all instances of a class have in common: everything but the values of their keys. Paths share it until one of
/// them needs another.
///
/// Threads: any, at any time, for reading. Only code that uses it alone may change it.
struct TPathFrame : TCounted {
    struct TPlace {
        boost::weak_ptr<ICIMNamespace> ns;
        std::string namespaceName;
        std::string host;
    };

    TPathFrame() = default;
    /// A copy with the first `count` names. Errors: std::bad_alloc.
    TPathFrame(const TPathFrame& other, std::size_t count)
        : TCounted(), place(other.place ? std::make_unique<TPlace>(*other.place) : nullptr), cls(other.cls),
          names(other.names.begin(), other.names.begin() + static_cast<std::ptrdiff_t>(count))
    {}

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

    bool HasSamePlace(const TPathFrame& other) const noexcept
    {
        if (!place || !other.place) {
            return place == other.place;
        }
        return !(place->ns < other.place->ns) && !(other.place->ns < place->ns) &&
               place->namespaceName == other.place->namespaceName && place->host == other.place->host;
    }

    friend void intrusive_ptr_add_ref(const TPathFrame* frame) noexcept { frame->Acquire(); }
    friend void intrusive_ptr_release(const TPathFrame* frame) noexcept
    {
        if (frame->Release()) {
            delete frame;
        }
    }

    std::unique_ptr<TPlace> place;  // null: no namespace and no host, as for most paths in an inventory
    boost::shared_ptr<ICIMClass> cls;
    std::vector<std::string> names;  // of the keys, and behind them of keys that the path had before
};

}  // namespace NORVZEL20

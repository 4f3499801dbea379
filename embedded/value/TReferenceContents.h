#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "embedded/value/TCounted.h"
#include "embedded/value/TKeyBindings.h"
#include "embedded/value/TPathFrame.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// The contents of a path: its key bindings, with the frame that it shares with other paths.
struct TCIMReference::TContents : TCounted {
    // Each level doubles the backslashes of the level within: without a bound, the text of a deep path would fill any memory.
    static constexpr unsigned int kMaxDepth = 12;

    TContents() = default;
    TContents(const TContents& other) : TCounted(), depth(other.depth), bindings(other.bindings) {}

    /// Contents of an empty path, new or recycled, with one use. Errors: std::bad_alloc.
    static TContents* Make();
    /// Gives up one use.
    static void Drop(TContents* contents) noexcept;
    /// Frees what this thread keeps of paths that have ended.
    static void FreeSpares() noexcept;

    /// Null if there is neither namespace nor host. `contents` may be null.
    static const TPathFrame::TPlace* FindPlace(const TContents* contents) noexcept
    {
        const TPathFrame* const frame = contents != nullptr ? contents->bindings.GetFrame() : nullptr;
        return frame != nullptr ? frame->place.get() : nullptr;
    }
    /// Null if there is no class. `contents` may be null.
    static const boost::shared_ptr<ICIMClass>* FindClass(const TContents* contents) noexcept
    {
        const TPathFrame* const frame = contents != nullptr ? contents->bindings.GetFrame() : nullptr;
        return frame != nullptr && frame->cls ? &frame->cls : nullptr;
    }

    /// Whether two paths with these contents could be told apart by nothing.
    bool IsIndistinguishable(const TContents& other) const noexcept;
    /// How deep references are nested in `value`; 0 if there is none.
    static unsigned int GetDepth(const TCIMValue& value);

    struct TSpares;
    struct TSparesEnd;

    unsigned int depth = 0;  // how deep references are nested in the bindings
    TKeyBindings bindings;   // in the order of the names in lower case
};

}  // namespace NORVZEL20

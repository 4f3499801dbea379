// Paths that are made for their text come and go with every look-up of an instance, so each thread keeps the contents of the last
// few paths that ended, with the memory of their bindings.
//
// The list of spares needs no destructor, so paths may end at any moment of a thread, also after its other thread-local objects.
// A separate object frees the spares when the thread ends; from then on none are kept. If the first path
// of a thread ends that late, its contents are not freed.

#include "embedded/value/TReferenceContents.h"

#include <algorithm>

#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kMostKeptBindings = 8;

}  // namespace

struct TCIMReference::TContents::TSpares {
    static constexpr unsigned int kMost = 4;

    TContents* contents[kMost];
    unsigned int count;
    bool isClosed;

    static TSpares& OfThread() noexcept
    {
        thread_local TSpares fgSpares{};
        return fgSpares;
    }
};

/// Ends the keeping of spares with its thread.
struct TCIMReference::TContents::TSparesEnd {
    TSpares& spares;

    ~TSparesEnd()
    {
        spares.isClosed = true;
        FreeSpares();
    }
};

void TCIMReference::TContents::FreeSpares() noexcept
{
    TSpares& spares = TSpares::OfThread();
    while (spares.count > 0) {
        delete spares.contents[--spares.count];
    }
}

TCIMReference::TContents* TCIMReference::TContents::Make()
{
    TSpares& spares = TSpares::OfThread();
    if (spares.count == 0) {
        return new TContents;
    }
    TContents* const contents = spares.contents[--spares.count];
    contents->Revive();
    return contents;
}

void TCIMReference::TContents::Drop(TContents* contents) noexcept
{
    if (!contents->Release()) {
        return;
    }
    // What the path held may be the last use of other paths, which end here and become spares themselves.
    contents->bindings.Clear();
    contents->depth = 0;
    TSpares& spares = TSpares::OfThread();
    if (spares.isClosed || spares.count == TSpares::kMost || contents->bindings.GetCapacity() > kMostKeptBindings) {
        delete contents;
        return;
    }
    thread_local const TSparesEnd fgEnd{spares};
    static_cast<void>(fgEnd);
    spares.contents[spares.count++] = contents;
}

bool TCIMReference::TContents::IsIndistinguishable(const TContents& other) const noexcept
{
    // Values first: paths to instances of one class differ in nothing else.
    bool isSame = bindings.GetCount() == other.bindings.GetCount();
    for (std::size_t position = 0; isSame && position < bindings.GetCount(); ++position) {
        isSame = TValueAccess::IsIndistinguishable(bindings.GetValue(position), other.bindings.GetValue(position));
    }
    return isSame && bindings.HasSameFrame(other.bindings);
}

unsigned int TCIMReference::TContents::GetDepth(const TCIMValue& value)
{
    switch (TValueAccess::GetForm(value)) {
    case TValueAccess::kPath: {
        const TContents* const contents = TValueAccess::GetPath(value).fContents;
        // Each path keeps its own depth, so this does not descend into it.
        return contents != nullptr ? contents->depth + 1 : 1;
    }
    case TValueAccess::kArray:
    case TValueAccess::kBag: {
        unsigned int depth = 0;
        for (const TCIMValue& element : value.GetElements()) {
            depth = std::max(depth, GetDepth(element));
        }
        return depth;
    }
    case TValueAccess::kObject: {
        // A key text quotes the paths within an object like those within an array.
        unsigned int depth = 0;
        for (const TEmbeddedObject::TProperty& property : value.GetEmbeddedObject()->GetProperties()) {
            depth = std::max(depth, GetDepth(property.value));
        }
        return depth;
    }
    default:
        return 0;
    }
}

}  // namespace NORVZEL20

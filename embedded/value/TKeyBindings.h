#pragma once

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <cstdint>
#include <string>

#include "embedded/value/TPathFrame.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The key bindings of a path, each a name and a value, in the order in which they are put in, with the frame of the path, which
/// holds the names.
///
/// Paths that are made for their text have the same names again and again. So Clear keeps the frame with the names, if nobody else
/// uses it, and the memory of the values.
/// Positions must be less than GetCount().
class TKeyBindings {
  public:
    TKeyBindings() noexcept : fOne() {}
    /// Shares the frame. Errors: std::bad_alloc.
    TKeyBindings(const TKeyBindings& other);
    TKeyBindings& operator=(const TKeyBindings&) = delete;
    ~TKeyBindings();

    std::size_t GetCount() const noexcept { return fCount; }
    const std::string& GetName(std::size_t position) const noexcept { return fFrame->names[position]; }
    const TCIMValue& GetValue(std::size_t position) const noexcept { return GetValues()[position]; }
    /// Null for a path that has nothing but values so far.
    const TPathFrame* GetFrame() const noexcept { return fFrame.get(); }

    /// The frame, used by these bindings alone and ready to be changed, its names excepted. Errors of this and all that follow:
    /// std::bad_alloc, and then nothing has changed.
    TPathFrame& OwnFrame();
    void Reserve(std::size_t count);
    void Append(const std::string& name, const TCIMValue& value) { Insert(fCount, name, value); }
    void Append(std::string&& name, const TCIMValue& value);
    void Insert(std::size_t position, const std::string& name, const TCIMValue& value);
    void SetValue(std::size_t position, const TCIMValue& value) noexcept { GetValues()[position] = value; }
    /// Takes out all bindings, the class and the place.
    void Clear() noexcept;
    /// How many bindings there is memory for.
    std::size_t GetCapacity() const noexcept { return fCapacity; }

    /// Whether both have the same class, the same place, and the same names, all spelled the same way.
    bool HasSameFrame(const TKeyBindings& other) const noexcept;
    /// Uses the frame of `other`, which is the same, and frees its own.
    void ShareFrame(const TKeyBindings& other) noexcept { fFrame = other.fFrame; }

  private:
    const TCIMValue* GetValues() const noexcept { return fCapacity > 1 ? fMany : &fOne; }
    TCIMValue* GetValues() noexcept { return fCapacity > 1 ? fMany : &fOne; }
    void FreeValues() noexcept;
    void MakeRoom();
    void InsertName(std::size_t position, std::string&& name);
    void InsertValue(std::size_t position, const TCIMValue& value) noexcept;

    boost::intrusive_ptr<TPathFrame> fFrame;  // null if there never was a name, a class or a place
    std::uint32_t fCount = 0;
    std::uint32_t fCapacity = 1;
    // The values; those behind the first fCount are null. Most paths have one key, so its value needs no memory of its own.
    union {
        TCIMValue fOne;    // if the capacity is 1
        TCIMValue* fMany;  // owned
    };
};

}  // namespace NORVZEL20

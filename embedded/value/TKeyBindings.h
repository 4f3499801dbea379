#pragma once

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The key bindings of a path, each a name and a value, in the order in which they are put in.
///
/// Paths that are made for their text have the same names again and again. So Clear keeps the bindings with their names, without
/// values, and Append takes one of them if there is one.
class TKeyBindings {
  public:
    using TBinding = std::pair<std::string, TCIMValue>;

    TKeyBindings() = default;
    TKeyBindings(const TKeyBindings& other) : fBindings(other.begin(), other.end()), fCount(other.fCount) {}
    TKeyBindings& operator=(const TKeyBindings&) = delete;
    ~TKeyBindings() = default;

    const TBinding* begin() const noexcept { return fBindings.data(); }
    const TBinding* end() const noexcept { return begin() + fCount; }
    TBinding* begin() noexcept { return fBindings.data(); }
    TBinding* end() noexcept { return begin() + fCount; }
    std::size_t size() const noexcept { return fCount; }
    bool empty() const noexcept { return fCount == 0; }
    const TBinding& operator[](std::size_t position) const noexcept { return fBindings[position]; }
    const TBinding& back() const noexcept { return fBindings[fCount - 1]; }

    /// Errors of all that follow: std::bad_alloc, and then nothing has changed.
    void Reserve(std::size_t count) { fBindings.reserve(count); }
    void Append(const std::string& name, const TCIMValue& value);
    void Append(std::string&& name, TCIMValue&& value);
    void Insert(const TBinding* place, const std::string& name, const TCIMValue& value);
    /// Takes all bindings out.
    void Clear() noexcept;
    /// How many bindings there is memory for.
    std::size_t GetCapacity() const noexcept { return fBindings.capacity(); }

  private:
    void DropSpares() { fBindings.resize(fCount); }

    std::vector<TBinding> fBindings;  // those behind the first fCount are spare and have no values
    std::size_t fCount = 0;
};

}  // namespace NORVZEL20

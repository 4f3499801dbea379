#pragma once

#include <cstdint>
#include <memory>

#include "embedded/store/TInMemLayout.h"
#include "embedded/store/TInMemProperty.h"

namespace NORVZEL20 {

class TInMemInstance;

/// A row of properties that an instance has beyond those behind itself, in one piece of memory headed by this.
class TInMemLateBlock {
  public:
    /// Destroys the properties and gives the memory back.
    struct TDelete {
        void operator()(TInMemLateBlock* block) const noexcept;
    };
    using TPointer = std::unique_ptr<TInMemLateBlock, TDelete>;

    TInMemLateBlock(const TInMemLateBlock&) = delete;
    TInMemLateBlock& operator=(const TInMemLateBlock&) = delete;

    /// A block of `instance` with a null for each of the slots of `layout` from `first` on, as many as there are and fit.
    /// Errors: std::bad_alloc.
    static TPointer Make(TInMemInstance& instance, const TInMemLayout& layout, std::uint32_t first);

    TInMemInstance& GetInstance() const noexcept { return fInstance; }
    /// The slot of the first property.
    std::uint32_t GetFirst() const noexcept { return fFirst; }
    /// The slot behind that of the last one.
    std::uint32_t GetEnd() const noexcept { return fFirst + fCount; }
    TInMemProperty& GetProperty(std::uint32_t position) noexcept { return reinterpret_cast<TInMemProperty*>(this + 1)[position]; }
    /// The block whose first property that is.
    static const TInMemLateBlock& GetBlock(const TInMemProperty& first) noexcept
    {
        return *(reinterpret_cast<const TInMemLateBlock*>(&first) - 1);
    }

  private:
    TInMemLateBlock(TInMemInstance& instance, std::uint32_t first, std::uint32_t count) noexcept
        : fInstance(instance), fFirst(first), fCount(count)
    {}
    ~TInMemLateBlock() = default;

    TInMemInstance& fInstance;
    std::uint32_t fFirst;
    std::uint32_t fCount;
};

}  // namespace NORVZEL20

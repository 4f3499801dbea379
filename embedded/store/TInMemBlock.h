#pragma once

#include <cstddef>
#include <cstdint>

#include "embedded/store/TInMemLayout.h"
#include "embedded/store/TInMemProperty.h"

namespace NORVZEL20 {

class TInMemInstance;

/// A run of properties in one piece of memory, headed by the instance that they belong to.
///
/// Whoever provides the memory releases it, after Destroy. A property finds its instance through the head of its block.
class TInMemBlock {
  public:
    TInMemBlock(const TInMemBlock&) = delete;
    TInMemBlock& operator=(const TInMemBlock&) = delete;

    /// How many bytes a block of `count` properties takes.
    static std::size_t GetSize(std::uint32_t count) noexcept;
    /// Makes a block in `memory`, which has GetSize(count) bytes: a property that is null for each of `count` slots
    /// of `layout` from `first` on.
    static TInMemBlock& Make(void* memory, TInMemInstance& owner, const TInMemLayout& layout, std::uint32_t first,
                             std::uint32_t count) noexcept;
    /// Destroys the block and its `count` properties.
    void Destroy(std::uint32_t count) noexcept;

    TInMemProperty& GetProperty(std::uint32_t position) noexcept { return GetProperties()[position]; }
    /// The instance of a property that is at `position` of its block.
    static TInMemInstance& GetOwner(const TInMemProperty& property, std::uint32_t position) noexcept
    {
        return (reinterpret_cast<const TInMemBlock*>(&property - position) - 1)->fOwner;
    }

  private:
    explicit TInMemBlock(TInMemInstance& owner) noexcept : fOwner(owner) {}
    ~TInMemBlock() = default;

    TInMemProperty* GetProperties() noexcept { return reinterpret_cast<TInMemProperty*>(this + 1); }

    TInMemInstance& fOwner;
};

}  // namespace NORVZEL20

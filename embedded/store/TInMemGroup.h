#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>

#include "embedded/store/TInMemInstance.h"

namespace NORVZEL20 {

class TInMemClass;

/// A few instances of one class in one piece of memory. Shared pointers to any of them keep the group, so all end when the last
/// pointer goes.
///
/// Threads: as the namespace of the class.
class TInMemGroup : public boost::enable_shared_from_this<TInMemGroup> {
  public:
    /// Enough for what the instances share to cost each little. An instance that outlives the others keeps no more alive.
    static constexpr std::uint32_t kMostInstances = 16;

    /// A group with room for `count` instances, from 1 to kMostInstances, that have the properties that `cls` has now.
    /// Errors: std::bad_alloc.
    static boost::shared_ptr<TInMemGroup> Create(boost::shared_ptr<TInMemClass> cls, std::uint32_t count);
    TInMemGroup(const TInMemGroup&) = delete;
    TInMemGroup& operator=(const TInMemGroup&) = delete;
    ~TInMemGroup();

    const boost::shared_ptr<TInMemClass>& GetClass() const noexcept { return fClass; }
    /// Whether one more instance fits, and the class has no more properties than when the group was made.
    bool HasRoom() const noexcept;
    /// Makes an instance with every property null. There must be room.
    TInMemInstance& Make() noexcept;

  private:
    TInMemGroup(boost::shared_ptr<TInMemClass> cls, std::uint32_t slots, std::uint32_t count) noexcept;
    TInMemInstance& GetInstance(std::uint32_t position) noexcept;

    boost::shared_ptr<TInMemClass> fClass;
    std::uint8_t fSlots;  // properties behind each instance
    std::uint8_t fCapacity;
    std::uint8_t fCount = 0;
};

}  // namespace NORVZEL20
